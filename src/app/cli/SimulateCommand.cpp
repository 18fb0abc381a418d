#include "app/cli/SimulateCommand.h"

#include <algorithm>
#include <ostream>
#include <string_view>

#include "app/cli/CommandLine.h"
#include "app/cli/Files.h"
#include "scenario/ScenarioReport.h"

namespace plume {

namespace {

void writeLine(std::ostream& stream, std::string_view text) {
    stream << text;
    if (!text.empty() && text.back() != '\n') stream << '\n';
}

}  // namespace

int simulateFiles(const std::vector<std::string>& files, const std::optional<std::string>& onlyCase,
                  std::ostream& output, std::ostream& error) {
    int status = ExitStatus::Success;
    for (const std::string& file : files) {
        const Result<std::string> text = readWholeFile(file);
        if (!text) {
            error << "plume: " << text.error().message << '\n';
            status = std::max(status, ExitStatus::WrongInput);
            continue;
        }
        const ScenarioReport report = simulate(text.value(), file, onlyCase);
        writeLine(output, report.output);
        writeLine(error, report.problems);
        status = std::max(status, report.exitStatus);
    }
    return status;
}

}  // namespace plume
