// Groups that come with Plume, and groups of corrections made of dictionaries that do.
//
// Owned by the editor's window, on the thread that owns the library; the editor and the files outlive it. What is added
// is one edit, which can be undone. After an error, which names the file, nothing was added.
#pragma once

#include <memory>
#include <string>
#include <vector>

#include "Foundation/Result.h"
#include "app/editing/LibraryEditor.h"
#include "platform/Files.h"

namespace plume {

class BuiltInGroups {
  public:
    using Added = Result<std::shared_ptr<SnippetGroup>>;

    // `folder` is the one that holds "groups" and "dictionaries".
    BuiltInGroups(LibraryEditor& editor, const Files& files, Files::Path folder);

    // The first group of the resource, behind all others.
    Added addBuiltInGroup(const std::string& resourceName);
    // A group of the resource's name; see dictionaryGroup().
    Added addDictionary(const std::string& resourceName, CaseSensitivity caseSensitivity);
    // "English" and the like: the dictionary of corrections for a language.
    Added addAutoCorrectDictionary(const std::string& language);

    // What addBuiltInGroup() and addAutoCorrectDictionary() know, in the order of the menus.
    static const std::vector<std::string>& groupNames();
    static const std::vector<std::string>& dictionaryLanguages();

  private:
    std::shared_ptr<SnippetGroup> add(std::shared_ptr<SnippetGroup> group);

    LibraryEditor& editor_;
    const Files& files_;
    const Files::Path folder_;
};

}  // namespace plume
