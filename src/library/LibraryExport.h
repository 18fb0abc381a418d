// Writes libraries and groups as files that people keep or take elsewhere.
#pragma once

#include <memory>
#include <string>

#include "library/LibraryArchive.h"

namespace plume {

// Two fields a snippet: the abbreviation with its prefix and the plain content.
std::string csvFromLibrary(const SnippetGroups& groups);
// A third one with the label.
std::string csvFromGroup(const SnippetGroup& group);

// To be read and printed: a heading for each group, below it the abbreviations with their prefixes in bold, each before
// its label and above its content as it is formatted. Attached files are left out.
std::string rtfFromGroups(const SnippetGroups& groups);

// "plume" and the like, in lower case and without the dot; empty without one.
std::string extensionOf(const std::string& fileName);

}  // namespace plume
