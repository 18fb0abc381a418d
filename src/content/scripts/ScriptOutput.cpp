#include "content/scripts/ScriptOutput.h"

#include <algorithm>
#include <string_view>

#include "Foundation/Strings.h"

namespace plume {

namespace {

// More than any system keeps in a pipe for its reader.
constexpr int ReadsForRest = 32;

void readAll(ProcessStream& stream, std::string& bytes) {
    for (int i = 0; i < ReadsForRest && stream.read(bytes); ++i) {
    }
}

}  // namespace

ScriptOutput ScriptOutput::notStarted(const Error& reason) {
    ScriptOutput nothing;
    nothing.end = ScriptEnd::NotStarted;
    nothing.problem = reason.message;
    return nothing;
}

void ScriptOutput::read(ProcessStream& outputStream, ProcessStream& errorStream) {
    outputStream.read(output);
    errorStream.read(error);
}

void ScriptOutput::readRest(ProcessStream& outputStream, ProcessStream& errorStream) {
    readAll(outputStream, output);
    readAll(errorStream, error);
}

std::optional<std::u16string> ScriptOutput::text() const {
    std::string_view bytes = output.empty() ? error : output;
    if (bytes.empty()) return std::nullopt;
    if (bytes.ends_with('\n')) bytes.remove_suffix(1);
    return fromStrictUtf8(bytes);
}

std::optional<std::u16string> ScriptOutput::delivered() const {
    return end == ScriptEnd::Finished || end == ScriptEnd::TimeLimit ? text() : std::nullopt;
}

ScriptWatch::ScriptWatch(const ScriptLimits& limits, const std::atomic<bool>& stopped)
    : outputLimit_(limits.output),
      stopped_(stopped),
      deadline_(Moment::clock::now() +
                std::chrono::duration_cast<Moment::duration>(std::chrono::duration<double>(limits.time))) {}

std::optional<ScriptEnd> ScriptWatch::verdict(const ScriptOutput& written) const {
    if (stopped_) return ScriptEnd::Stopped;
    if (std::max(written.output.size(), written.error.size()) > outputLimit_) return ScriptEnd::OutputLimit;
    if (Moment::clock::now() >= deadline_) return ScriptEnd::TimeLimit;
    return std::nullopt;
}

Moment ScriptWatch::nextLook() const {
    constexpr auto Interval = std::chrono::milliseconds(100);
    return std::min(deadline_, Moment::clock::now() + Interval);
}

}  // namespace plume
