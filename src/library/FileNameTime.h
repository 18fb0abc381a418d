// The local time as it stands in the names of files: "2026-01-31 10-00-00".
#pragma once

#include <string>

#include "Foundation/Date.h"

namespace plume {

std::string fileNameTime(Date date);

}  // namespace plume
