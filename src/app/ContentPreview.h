// What will come out of a snippet, as far as that can be said without running or asking anything.
//
// Dates and the clipboard are filled in. A field shows what it begins with, or its name in brackets; a script is named
// and not run. Belongs to the thread that has the snippet.
#pragma once

#include <memory>
#include <optional>
#include <string>

#include "content/ContentEnvironment.h"
#include "content/SnippetExpandedContent.h"
#include "library/LibraryArchive.h"

namespace plume {

struct ContentPreview {
    SnippetExpandedContent::Content content;
    bool isScript = false;  // the content is its source, and what it prints is delivered

    // What there is of it as text.
    const std::u16string& text() const;
};

// Nothing when the snippet cannot be expanded. `locale` is that of numbers; empty: the user's. The environment's report
// is not called for what is only shown.
std::optional<ContentPreview> previewOf(const std::shared_ptr<Snippet>& snippet, const SnippetGroups& groups,
                                        ContentEnvironment environment, const std::string& locale);

}  // namespace plume
