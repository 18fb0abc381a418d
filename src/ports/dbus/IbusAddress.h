// Where IBus has the bus of its own.
#pragma once

#include <string>

namespace plume {

// As it has told for this display, such as ":0"; empty when it never ran there. It may be gone meanwhile.
std::string ibusAddress(const std::string& display);

}  // namespace plume
