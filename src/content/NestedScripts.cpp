#include "content/NestedScripts.h"

#include <algorithm>
#include <unordered_map>
#include <utility>
#include <vector>

#include "content/ContentRewriter.h"

namespace plume {

namespace {

using Variable = std::shared_ptr<SnippetAbbreviationVariable>;

// Where the variable's script stands in a text of this length.
Range rangeOfScript(const SnippetAbbreviationVariable& variable, std::size_t textLength) {
    const std::size_t start = std::min(variable.location, textLength);
    return {start, std::min(variable.scriptLength, textLength - start)};
}

bool contains(const Range& outer, const Range& inner) {
    return inner.location >= outer.location && inner.end() <= outer.end();
}

bool isLocatedBefore(const Variable& a, const Variable& b) {
    return a->location < b->location;
}

// Builds the scripts of a text in one pass over it.
class ScriptCutter {
  public:
    struct Cut {
        Range range;
        std::shared_ptr<PLScript> script;
    };

    explicit ScriptCutter(std::u16string_view text) : text_(text) {}

    // In ascending order of location, an outer script before those in it.
    void add(const Variable& variable) {
        const Range range = rangeOfScript(*variable, text_.size());
        while (!open_.empty() && !contains(open_.back().range, range)) closeLast();

        auto script = std::make_shared<PLScript>();
        script->snippetVariable = variable;
        script->isAppleScript = variable->isAppleScript;
        if (open_.empty()) {
            cuts_.push_back({range, script});
        } else {
            OpenScript& parent = open_.back();
            parent.copyUpTo(range.location, text_);
            parent.position = std::max(parent.position, range.end());
            script->location = parent.script->script.size();
            parent.script->nestedScripts.push_back(script);
        }
        open_.push_back({std::move(script), range, range.location});
    }

    // The scripts that lie in no other.
    std::vector<Cut> finish() {
        while (!open_.empty()) closeLast();
        return std::move(cuts_);
    }

  private:
    struct OpenScript {
        std::shared_ptr<PLScript> script;
        Range range;
        std::size_t position;  // how far the text is taken into the script, or cut out of it

        void copyUpTo(std::size_t end, std::u16string_view text) {
            if (end > position) script->script.append(text.substr(position, end - position));
        }
    };

    void closeLast() {
        open_.back().copyUpTo(open_.back().range.end(), text_);
        open_.pop_back();
    }

    std::u16string_view text_;
    std::vector<OpenScript> open_;  // each in the one before
    std::vector<Cut> cuts_;
};

// Where a place is once the cuts are made. What lay inside a script is brought to where that stood.
std::size_t locationAfterCuts(std::size_t location, const std::vector<ScriptCutter::Cut>& cuts) {
    const auto next = std::upper_bound(cuts.begin(), cuts.end(), location,
                                       [](std::size_t place, const auto& cut) { return place < cut.range.location; });
    if (next == cuts.begin()) return location;
    const ScriptCutter::Cut& cut = *(next - 1);
    return cut.script->location + (location > cut.range.end() ? location - cut.range.end() : 0);
}

// Takes the nested-snippet variables out of the list and notes how many others stand before each script's.
void removeScriptVariables(SnippetExpandedContent& content) {
    std::unordered_map<const SnippetVariable*, std::size_t> listedBefore;
    std::vector<std::shared_ptr<SnippetVariable>> others;
    for (auto& variable : content.variables) {
        if (dynamic_cast<const SnippetAbbreviationVariable*>(variable.get()) != nullptr) {
            listedBefore.emplace(variable.get(), others.size());
        } else {
            others.push_back(std::move(variable));
        }
    }
    content.variables = std::move(others);
    content.variablesBeforeScripts.clear();
    for (const auto& script : content.scripts) {
        content.variablesBeforeScripts.push_back(listedBefore[script->snippetVariable.get()]);
    }
}

// How many scripts stand in front of the variable: at the same place, the list's order before the cutting decides.
std::size_t scriptsBeforeVariable(const SnippetExpandedContent& content, std::size_t index) {
    const std::size_t location = content.variables[index]->location;
    const auto standsBefore = [&](const std::shared_ptr<PLScript>& script) {
        const auto number = static_cast<std::size_t>(&script - content.scripts.data());
        return script->location < location ||
               (script->location == location && content.variablesBeforeScripts[number] <= index);
    };
    const auto end = std::partition_point(content.scripts.begin(), content.scripts.end(), standsBefore);
    return static_cast<std::size_t>(end - content.scripts.begin());
}

}  // namespace

void processScripts(SnippetExpandedContent& content) {
    std::vector<Variable> variables = content.abbreviations();
    if (variables.empty()) return;
    std::stable_sort(variables.begin(), variables.end(), isLocatedBefore);
    ScriptCutter cutter(content.string());
    for (const Variable& variable : variables) cutter.add(variable);
    const std::vector<ScriptCutter::Cut> cuts = cutter.finish();

    ContentRewriter rewriter(content.content);
    content.scripts.clear();
    for (const auto& [range, script] : cuts) {
        rewriter.copyTo(range.location);
        script->location = rewriter.resultLength();
        rewriter.skipTo(range.end());
        content.scripts.push_back(script);
    }
    content.setContent(rewriter.finish());
    removeScriptVariables(content);
    for (const auto& variable : content.variables) variable->location = locationAfterCuts(variable->location, cuts);
}

std::shared_ptr<PLScript> newScriptWithAbbreviationVariable(const Variable& variable,
                                                            std::u16string_view snippetContent,
                                                            std::vector<Variable>& variables) {
    const Variable outer = variable;  // which may be an element of the list that changes here
    const Range range = rangeOfScript(*outer, snippetContent.size());
    const auto isApart = [&](const Variable& other) {
        return other != outer && !contains(range, rangeOfScript(*other, snippetContent.size()));
    };
    const auto firstInside = std::stable_partition(variables.begin(), variables.end(), isApart);
    std::stable_sort(firstInside, variables.end(), isLocatedBefore);

    ScriptCutter cutter(snippetContent);
    cutter.add(outer);
    for (auto inside = firstInside; inside != variables.end(); ++inside) {
        if (*inside != outer) cutter.add(*inside);
    }
    variables.erase(firstInside, variables.end());
    return cutter.finish().front().script;
}

void mergeScriptResults(SnippetExpandedContent& content) {
    ContentRewriter rewriter(content.content);
    std::vector<std::size_t> inserted = {0};  // by the scripts before each
    for (const auto& script : content.scripts) {
        const std::u16string result = script->result.value_or(u"");
        rewriter.copyTo(script->location);
        rewriter.append(result, script->snippetVariable->attributes);
        inserted.push_back(inserted.back() + result.size());
    }
    content.setContent(rewriter.finish());

    for (std::size_t index = 0; index < content.variables.size(); ++index) {
        content.variables[index]->location += inserted[scriptsBeforeVariable(content, index)];
    }
}

}  // namespace plume
