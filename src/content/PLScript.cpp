#include "content/PLScript.h"

#include <algorithm>
#include <utility>

#include "content/scripts/ScriptRunner.h"

namespace plume {

PLScript::~PLScript() {
    auto remaining = std::move(nestedScripts);
    while (!remaining.empty()) {
        const auto dropped = std::move(remaining.back());
        remaining.pop_back();
        if (!dropped || dropped.use_count() > 1) continue;
        for (auto& nested : dropped->nestedScripts) remaining.push_back(std::move(nested));
        dropped->nestedScripts.clear();
    }
}

// A walk with a list of its own instead of a recursion, so that no depth of nesting is too deep for a thread's stack.
void PLScript::execute(ScriptRunner& runner) {
    struct Level {
        PLScript* owner;
        std::size_t nextNested;
    };
    if (!isWanted()) return;
    std::vector<Level> levels{{this, 0}};
    while (!levels.empty()) {
        Level& level = levels.back();
        PLScript* const current = level.owner;
        if (level.nextNested < current->nestedScripts.size()) {
            PLScript* const nested = current->nestedScripts[level.nextNested++].get();
            if (nested->isWanted()) levels.push_back({nested, 0});
        } else {
            levels.pop_back();
            current->runMerged(runner);
        }
    }
}

void PLScript::mergerNestedScriptResults() {
    for (auto nested = nestedScripts.rbegin(); nested != nestedScripts.rend(); ++nested) {
        const Text& output = (*nested)->result;
        if (output) script.insert(std::min((*nested)->location, script.size()), *output);
    }
}

bool PLScript::isWanted() const {
    return !snippetVariable || !snippetVariable->isOptional || snippetVariable->isSelected;
}

void PLScript::runMerged(ScriptRunner& runner) {
    mergerNestedScriptResults();
    result = runner.run(script, isAppleScript);
    if (result && !result->empty() && suffix) *result += *suffix;
    executed.raise(*this);
}

}  // namespace plume
