// A script cut out of a content, or the content of a script snippet: run it, and its output is the text to deliver.
//
// Made on the thread that sends, then handed to a background thread that calls execute(); one thread at a time has it.
#pragma once

#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "Foundation/ZDEvent.h"
#include "content/SnippetAbbreviationVariable.h"

namespace plume {

class ScriptRunner;

class PLScript {
  public:
    using Text = std::optional<std::u16string>;

    PLScript() = default;
    // Takes the nested scripts apart level by level: scripts may be nested as deep as a content is long.
    ~PLScript();

    // Raised by execute(), on its thread, when the script has run.
    ZDEvent<PLScript> executed;

    std::shared_ptr<SnippetAbbreviationVariable> snippetVariable;
    bool isAppleScript = false;
    // Where the output goes: an index into the expanded content, or, for a nested script, into the parent's text.
    std::size_t location = 0;
    std::u16string script;  // with nested scripts cut out
    std::vector<std::shared_ptr<PLScript>> nestedScripts;
    Text result;
    Text suffix;  // appended to an output that is not empty

    // Runs the nested scripts in order, puts their results into the text, runs it, sets `result`. Blocks, whatever the
    // scripts do no longer than the runner lets them. An optional script that was not ticked gives nothing, and nothing
    // of it is run.
    void execute(ScriptRunner& runner);
    // Puts the nested results into `script`, each at its location; one that has no result adds nothing.
    void mergerNestedScriptResults();

  private:
    // False for an optional script that was not ticked.
    bool isWanted() const;
    // Runs this script alone.
    void runMerged(ScriptRunner& runner);
};

}  // namespace plume
