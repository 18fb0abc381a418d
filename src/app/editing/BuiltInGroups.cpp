#include "app/editing/BuiltInGroups.h"

#include <utility>

#include "Foundation/Strings.h"
#include "app/editing/DictionaryGroup.h"
#include "library/LibraryFile.h"

namespace plume {

BuiltInGroups::BuiltInGroups(LibraryEditor& editor, const Files& files, Files::Path folder)
    : editor_(editor), files_(files), folder_(std::move(folder)) {}

BuiltInGroups::Added BuiltInGroups::addBuiltInGroup(const std::string& resourceName) {
    const Files::Path path = folder_ / "groups" / (resourceName + ".json");
    const Result<std::string> bytes = files_.read(path);
    if (!bytes) return bytes.error();
    const auto groups = LibraryFile::read(bytes.value(), path.string());
    if (!groups) return groups.error();
    if (groups.value().empty()) return Error{path.string() + ": there is no group in it; expected one"};
    return add(groups.value().front());
}

BuiltInGroups::Added BuiltInGroups::addDictionary(const std::string& resourceName, CaseSensitivity caseSensitivity) {
    const Files::Path path = folder_ / "dictionaries" / resourceName;
    const Result<std::string> bytes = files_.read(path);
    if (!bytes) return bytes.error();
    if (!fromStrictUtf8(bytes.value())) return Error{path.string() + ": expected text in UTF-8"};
    auto group = dictionaryGroup(fromUtf8(resourceName), bytes.value(), caseSensitivity);
    if (group->items().empty())
        return Error{path.string() + ": expected pairs of lines, a misspelling and its correction"};
    return add(std::move(group));
}

BuiltInGroups::Added BuiltInGroups::addAutoCorrectDictionary(const std::string& language) {
    return addDictionary("AutoCorrect Dictionary (" + language + ")", CaseSensitivity::IgnoreCaseAndAdapt);
}

const std::vector<std::string>& BuiltInGroups::groupNames() {
    static const std::vector<std::string> names{"HTML", "HTML Use Clipboard", "JavaScript", "JavaScript Use Clipboard",
                                                "Symbol"};
    return names;
}

const std::vector<std::string>& BuiltInGroups::dictionaryLanguages() {
    static const std::vector<std::string> languages{"English", "French", "German"};
    return languages;
}

std::shared_ptr<SnippetGroup> BuiltInGroups::add(std::shared_ptr<SnippetGroup> group) {
    editor_.insertGroups({group}, editor_.groups().size(), EditKind::Addition);
    return group;
}

}  // namespace plume
