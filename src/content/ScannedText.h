// The two forms of text that placeholders are searched in, plain and rich: each a text that is edited in place from
// front to back, kept as what is finished and what is still to be scanned, so that every edit takes constant time.
#pragma once

#include <cstddef>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "Foundation/text/AttributedString.h"
#include "content/ExpansionContext.h"
#include "content/SnippetClipboardVariable.h"
#include "content/SnippetExpandedContent.h"
#include "library/Snippet.h"

namespace plume {

// Text still to be scanned: taken from its front, and put back there. A view of the original as long as nothing is put
// back; the original must outlive it.
class PendingText {
  public:
    explicit PendingText(std::u16string_view text) : rest_(text) {}

    std::u16string_view rest() const { return rest_; }
    void take(std::size_t count) { rest_.remove_prefix(count); }
    // Amortised time of the text's length.
    void putBack(std::u16string_view text);

  private:
    std::u16string_view rest_;  // the end of `buffer_`, once there is one
    std::vector<char16_t> buffer_;
};

// What a clipboard placeholder stands for: one of the two, or nothing.
struct ClipboardValue {
    std::optional<std::u16string> text;
    std::optional<AttributedString> richText;
};

class PlainScannedText {
  public:
    // Optional dates and times are shown in the form.
    static constexpr bool OptionalDatesBecomeFields = true;

    explicit PlainScannedText(std::u16string_view text);

    std::u16string_view rest() const { return pending_.rest(); }
    // How much is finished: where the rest starts.
    std::size_t location() const { return finished_.size(); }
    // Of the first unit of the rest.
    static SharedAttributes attributes() { return nullptr; }

    void keep(std::size_t count);
    void drop(std::size_t count) { pending_.take(count); }
    // Adds to what is finished.
    void write(std::u16string_view text, const SharedAttributes&) { finished_.append(text); }
    void write(const ClipboardValue& value, const SharedAttributes&);
    // Puts the nested snippet's content before the rest.
    void putBack(const Snippet& nested, const SharedAttributes& attributes);
    SnippetExpandedContent::Content finish() { return std::move(finished_); }

    // Takes its length off the context.
    static ClipboardValue clipboardValue(const SnippetClipboardVariable& variable, ExpansionContext& context);

  private:
    PendingText pending_;
    std::u16string finished_;
};

class RichScannedText {
  public:
    static constexpr bool OptionalDatesBecomeFields = false;

    explicit RichScannedText(const AttributedString& text);

    std::u16string_view rest() const { return pending_.rest(); }
    std::size_t location() const { return finished_.length(); }
    SharedAttributes attributes() const { return pendingRuns_.back().attributes; }

    void keep(std::size_t count);
    void drop(std::size_t count);
    void write(std::u16string_view text, const SharedAttributes& attributes) { finished_.append(text, attributes); }
    void write(const ClipboardValue& value, const SharedAttributes& attributes);
    // A rich content keeps its own attributes, any other takes those given.
    void putBack(const Snippet& nested, const SharedAttributes& attributes);
    SnippetExpandedContent::Content finish() { return std::move(finished_); }

    static ClipboardValue clipboardValue(const SnippetClipboardVariable& variable, ExpansionContext& context);

  private:
    // Takes from the first run of the rest, at most `count` units; returns how many.
    std::size_t takeFromRun(std::size_t count);
    void putBackRuns(const AttributedString& text);

    PendingText pending_;
    std::vector<AttributedString::Run> pendingRuns_;  // of the rest, its first one last
    AttributedString finished_;
};

}  // namespace plume
