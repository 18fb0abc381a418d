// Watches an edit of the library: what it is about to touch is named before it is touched.
//
// For one edit, on the thread that owns the library, which outlives it.
#pragma once

#include <memory>
#include <vector>

#include "app/editing/LibraryChange.h"

namespace plume {

class EditRecorder {
  public:
    // The list of groups is always watched.
    explicit EditRecorder(const SnippetGroups& library);

    void willChange(const std::shared_ptr<Snippet>& snippet);
    void willChangeSettings(const std::shared_ptr<SnippetGroup>& group);
    void willChangeItems(const std::shared_ptr<SnippetGroup>& group);

    // What has changed since; what turned out the same is left out. For one call, at the end.
    LibraryChange change(EditKind kind, std::size_t count = 1);

  private:
    const SnippetGroups& library_;
    const SnippetGroups before_;
    std::vector<LibraryChange::RecordStep<Snippet>> snippets_;
    std::vector<LibraryChange::RecordStep<SnippetGroup>> groups_;
    std::vector<LibraryChange::ItemsStep> items_;  // `removed` is the whole list of before
};

}  // namespace plume
