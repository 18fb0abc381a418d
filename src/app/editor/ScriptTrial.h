// Running a script snippet to see what comes out of it.
//
// A trial is prepared on the main thread, runs once on a background thread, and is asked by the main thread afterwards;
// whoever runs it owns it. Its runner may be told to stop from any thread.
#pragma once

#include <atomic>
#include <cstddef>
#include <functional>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

#include "content/ContentEnvironment.h"
#include "content/SnippetExpandedContent.h"
#include "content/scripts/ScriptOutput.h"
#include "library/LibraryArchive.h"
#include "platform/ProcessLauncher.h"

namespace plume {

// Runs the scripts of one trial.
class TrialRunner {
  public:
    virtual ~TrialRunner() = default;
    // Blocks until the script has ended.
    virtual ScriptOutput run(std::u16string_view script, bool isAppleScript) = 0;
    // Ends what runs, and runs nothing from now on. From any thread.
    virtual void stop() = 0;
};

// As expansions run them, in a shell of their own. The launcher outlives it.
std::shared_ptr<TrialRunner> makeTrialRunner(ProcessLauncher& launcher, const ScriptLimits& limits);

// What one stream says, as much of it as can be shown.
struct TriedText {
    static constexpr std::size_t MaximumLength = 50'000;  // UTF-16 units

    std::u16string text;
    std::size_t left = 0;  // units that were cut off
    bool isUtf8 = true;    // otherwise nothing of it is delivered
};

class ScriptTrial {
  public:
    // How the scripts ended, in the order in which they ran: those that the snippet includes, and the snippet itself.
    struct Ending {
        ScriptEnd end = ScriptEnd::Finished;
        bool failed = false;
        std::string problem;  // why it was not started
    };

    // The snippet with this text in place of its own, expanded as for delivery, where fields take what they begin with.
    // Null when it cannot be expanded. `locale` is that of numbers; empty: the user's.
    static std::shared_ptr<ScriptTrial> prepare(const std::shared_ptr<Snippet>& snippet, std::u16string_view text,
                                                const SnippetGroups& groups, ContentEnvironment environment,
                                                const std::string& locale);

    bool hasFields() const { return hasFields_; }
    // Blocks until the last script has ended.
    void run(TrialRunner& runner);

    const std::vector<Ending>& endings() const { return endings_; }
    // Of the snippet itself.
    const TriedText& output() const { return output_; }
    // Of all scripts.
    const TriedText& errors() const { return errors_; }

  private:
    class Recorder;

    std::shared_ptr<SnippetExpandedContent> content_;
    bool isAppleScript_ = false;
    bool hasFields_ = false;
    std::vector<Ending> endings_;
    TriedText output_;
    TriedText errors_;
};

}  // namespace plume
