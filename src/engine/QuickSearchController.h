// The window in which the user searches the library for a snippet to send, as the engine drives it.
//
// Owned by the engine and used on the thread that delivers the key events; a port whose windows live on another thread
// hands over and answers at once from what it was last told.
#pragma once

#include <cstddef>
#include <cstdint>
#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "library/SnippetGroup.h"
#include "platform/Accessibility.h"

namespace plume {

class QuickSearchController {
  public:
    virtual ~QuickSearchController() = default;

    virtual void setSnippetGroups(const std::vector<std::shared_ptr<SnippetGroup>>& groups) = 0;
    // Called, on the thread of the key events, when the user has chosen a snippet.
    virtual void setSnippetSelectedAction(std::function<void()> action) = 0;
    // Which modifier picks entries with digit keys, for showing it: 0 none, n the one of bit n - 1.
    virtual void setSnippetSelectorKeyModifier(std::int64_t modifier) = 0;

    virtual void showWindowAtCaret() = 0;
    virtual void showWindowAtTopRightCorner() = 0;
    virtual void close() = 0;

    // Null when nothing is chosen.
    virtual std::shared_ptr<Snippet> selectedSnippet() const = 0;
    // What the user had typed for it before the window came, and is erased when it is sent; nothing as a rule.
    virtual const std::optional<std::u16string>& typedText() const = 0;
    // The snippet in this line of the results, null past their end.
    virtual std::shared_ptr<Snippet> snippetAtIndex(std::size_t index) const = 0;

    virtual bool windowVisible() const = 0;
    // On the screen, in the coordinates in which mouse events are reported.
    virtual Rectangle windowFrame() const = 0;
};

}  // namespace plume
