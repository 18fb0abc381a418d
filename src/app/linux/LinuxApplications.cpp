#include "app/linux/LinuxApplications.h"

#include <utility>

namespace plume {

namespace {

std::shared_ptr<const ApplicationTable> shared(Result<ApplicationTable> table) {
    return std::make_shared<const ApplicationTable>(std::move(table).value());
}

}  // namespace

LinuxApplications readLinuxApplications(const Result<std::string>& text, const std::string& fileName) {
    Error problem;
    if (text) {
        auto table = ApplicationTable::read(text.value(), fileName);
        if (table) return {shared(std::move(table)), std::nullopt};
        problem = table.error();
    } else {
        problem = text.error();
    }
    return {shared(ApplicationTable::read(compiledInApplications(), "applications.json")), std::move(problem)};
}

}  // namespace plume
