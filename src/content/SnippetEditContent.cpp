#include "content/SnippetEditContent.h"

#include "content/ContentRewriter.h"
#include "content/PlaceholderBody.h"
#include "content/PlaceholderKinds.h"

namespace plume {
namespace {

constexpr char16_t AttachmentCharacter = u'\uFFFC';

std::u16string bracketed(std::u16string_view body) {
    std::u16string text(1, OpeningMarker);
    text += body;
    text += ClosingMarker;
    return text;
}

// The chip of a body, otherwise with the attributes given.
SharedAttributes chipAttributes(std::u16string_view body, const SharedAttributes& base) {
    TextAttributes attributes = base ? *base : TextAttributes();
    TextAttachment cell;
    cell.cellText = body;
    attributes.attachment = std::make_shared<const TextAttachment>(std::move(cell));
    return std::make_shared<const TextAttributes>(std::move(attributes));
}

bool isChip(const SharedAttributes& attributes) {
    return attributes && attributes->attachment && !attributes->attachment->cellText.empty();
}

SharedAttributes withoutAttachment(const SharedAttributes& attributes) {
    TextAttributes rest = *attributes;
    rest.attachment = nullptr;
    return rest == TextAttributes() ? nullptr : std::make_shared<const TextAttributes>(std::move(rest));
}

}  // namespace

AttributedString attributedStringFromVariable(std::u16string_view body) {
    return AttributedString(std::u16string(1, AttachmentCharacter), chipAttributes(body, nullptr));
}

AttributedString convertToSnippetEditContent(const AttributedString& content) {
    const std::u16string_view text = content.string();
    AttributedStringRewriter rewriter(content);
    std::size_t opening = std::u16string_view::npos;  // the last one that nothing has closed yet
    for (std::size_t i = 0; i < text.size(); ++i) {
        if (text[i] == OpeningMarker) opening = i;
        if (text[i] != ClosingMarker || opening == std::u16string_view::npos) continue;
        const std::u16string_view body = text.substr(opening + 1, i - opening - 1);
        if (startsWithKeyword(body)) {
            rewriter.copyTo(opening);
            rewriter.append(std::u16string_view(&AttachmentCharacter, 1), chipAttributes(body, rewriter.attributes()));
            rewriter.skipTo(i + 1);
        }
        opening = std::u16string_view::npos;
    }
    return rewriter.finish();
}

AttributedString convertFromSnippetEditContent(const AttributedString& content) {
    const std::u16string_view text = content.string();
    AttributedStringRewriter rewriter(content);
    for (std::size_t i = text.find(AttachmentCharacter); i != std::u16string_view::npos;
         i = text.find(AttachmentCharacter, i + 1)) {
        rewriter.copyTo(i);
        const SharedAttributes attributes = rewriter.attributes();
        if (!isChip(attributes)) continue;
        rewriter.append(bracketed(attributes->attachment->cellText), withoutAttachment(attributes));
        rewriter.skipTo(i + 1);
    }
    return rewriter.finish();
}

}  // namespace plume
