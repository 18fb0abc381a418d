// How programs of a Linux desktop are typed to: data/applications.json.
#pragma once

#include <memory>
#include <optional>
#include <string>
#include <string_view>

#include "Foundation/Result.h"
#include "input/delivery/ApplicationTable.h"

namespace plume {

struct LinuxApplications {
    std::shared_ptr<const ApplicationTable> table;  // never null
    std::optional<Error> problem;                   // why it is not what the file says
};

// `text` is the installed file's. Where that is missing or damaged, the table is the one that was compiled in.
LinuxApplications readLinuxApplications(const Result<std::string>& text, const std::string& fileName);

// The file as it was when this program was built.
std::string_view compiledInApplications();

}  // namespace plume
