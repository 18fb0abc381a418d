#include "Foundation/text/RTFAttributes.h"

#include <algorithm>
#include <iterator>
#include <utility>

#include "Foundation/Strings.h"

namespace plume {

namespace {

const std::u16string DefaultFamily = u"Helvetica";
constexpr std::size_t MaximumCachedAttributes = 4096;
// Many small changes of format under a long link could ask for far more memory than the document takes.
constexpr std::size_t MaximumAttributesSize = std::size_t{256} << 20;

double points(int twips) {
    return twips / static_cast<double>(RTFTwipsPerPoint);
}

std::size_t estimatedSize(const TextAttributes& attributes) {
    std::size_t units = attributes.font ? attributes.font->family.size() : 0;
    if (attributes.link) units += attributes.link->size();
    if (attributes.toolTip) units += attributes.toolTip->size();
    std::size_t size = sizeof(TextAttributes) + units * sizeof(char16_t);
    if (attributes.paragraphStyle) {
        size += attributes.paragraphStyle->tabStops.size() * sizeof(double) +
                attributes.paragraphStyle->textLists.size() * sizeof(TextList);
    }
    return size;
}

// The name without the number that tells files of one name apart.
std::u16string fileNameWithoutNumber(const std::u16string& name) {
    const std::size_t digits = std::min(name.find_first_not_of(u"0123456789"), name.size());
    const bool numbered = digits > 0 && std::u16string_view(name).substr(digits).starts_with(RTFFileNumberMark);
    return numbered ? name.substr(digits + RTFFileNumberMark.size()) : name;
}

// The next piece of a field's instruction, without its quotes; a backslash in quotes keeps a quote or a backslash.
std::u16string takeFieldPiece(std::u16string_view& rest) {
    while (!rest.empty() && rest.front() <= u' ') rest.remove_prefix(1);
    const bool quoted = rest.starts_with(u'"');
    if (quoted) rest.remove_prefix(1);
    std::u16string piece;
    while (!rest.empty()) {
        char16_t unit = rest.front();
        if (!quoted && unit <= u' ') break;
        rest.remove_prefix(1);
        if (quoted && unit == u'"') break;
        if (quoted && unit == u'\\' && !rest.empty() && (rest.front() == u'"' || rest.front() == u'\\')) {
            unit = rest.front();
            rest.remove_prefix(1);
        }
        piece.push_back(unit);
    }
    return piece;
}

}  // namespace

RTFAttributes::RTFAttributes(const RTFFontTable& fonts, const RTFColorTable& colors, const RTFListTable& lists,
                             const RTFFiles& files)
    : fonts_(fonts), colors_(colors), lists_(lists), files_(files) {}

// ---- Attachments and links ----

int RTFAttributes::attachmentNumber(std::u16string_view fileName) {
    const auto known = attachmentNumbers_.find(fileName);
    if (known != attachmentNumbers_.end()) return known->second;
    const auto file = files_.find(std::u16string(fileName));
    if (file == files_.end()) return 0;
    attachments_.push_back(
        std::make_shared<const TextAttachment>(TextAttachment{fileNameWithoutNumber(file->first), file->second, {}}));
    return attachmentNumbers_.emplace(fileName, static_cast<int>(attachments_.size())).first->second;
}

int RTFAttributes::addLink(std::u16string_view instruction) {
    std::u16string_view rest = trimmed(instruction);
    if (!equalsIgnoringCase(takeFieldPiece(rest), u"HYPERLINK")) return 0;
    Link link;
    while (!rest.empty()) {
        const std::u16string piece = takeFieldPiece(rest);
        if (piece == u"\\l") {
            link.address += u"#" + takeFieldPiece(rest);
        } else if (piece == u"\\o") {
            link.toolTip = takeFieldPiece(rest);
        } else if (piece == u"\\t") {
            takeFieldPiece(rest);
        } else if (link.address.empty() && !(piece.size() == 2 && piece.front() == u'\\')) {
            link.address = piece;
        }
    }
    if (link.address.empty()) return 0;
    links_.push_back(std::move(link));
    return static_cast<int>(links_.size());
}

// ---- Attributes ----

void RTFAttributes::useParagraphFormat(const RTFParagraphFormat& format) {
    if (format == paragraphFormat_) return;
    paragraphFormat_ = format;
    made_.clear();
    ParagraphStyle style;
    style.alignment = format.alignment;
    style.headIndent = points(format.leftIndent);
    style.firstLineHeadIndent = points(format.leftIndent + format.firstLineIndent);
    style.tailIndent = format.rightIndent > 0 ? -points(format.rightIndent) : 0;
    style.lineSpacing = points(format.leading);
    if (format.isLineMultiple) style.lineHeightMultiple = format.lineHeight / static_cast<double>(RTFUnitsPerLine);
    style.paragraphSpacing = points(format.spaceAfter);
    style.paragraphSpacingBefore = points(format.spaceBefore);
    if (format.tabStops) {
        std::transform(format.tabStops->begin(), format.tabStops->end(), std::back_inserter(style.tabStops), points);
    }
    if (format.list != 0) style.textLists = lists_.listsAt(format.list, format.listLevel);
    paragraphStyle_ = style == ParagraphStyle{} ? std::nullopt : std::optional(std::move(style));
}

SharedAttributes RTFAttributes::attributesOf(const RTFCharacterFormat& format) {
    if (made_.size() > MaximumCachedAttributes) made_.clear();
    const auto found = made_.find(format);
    if (found != made_.end()) return found->second;
    return made_.emplace(format, makeAttributes(format)).first->second;
}

FontAttribute RTFAttributes::fontOf(const RTFCharacterFormat& format) const {
    const RTFFont* font = fonts_.find(format.font);
    FontAttribute attribute;
    attribute.family = font && !font->family.empty() ? font->family : DefaultFamily;
    attribute.size = format.halfPoints / static_cast<double>(RTFHalfPointsPerPoint);
    attribute.bold = format.bold || (font && font->bold);
    attribute.italic = format.italic || (font && font->italic);
    return attribute;
}

SharedAttributes RTFAttributes::makeAttributes(const RTFCharacterFormat& format) {
    if (madeSize_ > MaximumAttributesSize) return nullptr;
    auto attributes = std::make_shared<TextAttributes>();
    if (format.hasFont) attributes->font = fontOf(format);
    attributes->foregroundColor = colors_.find(format.foreground);
    attributes->backgroundColor = colors_.find(format.background);
    attributes->underlineStyle = format.underline;
    attributes->strikethroughStyle = format.strikethrough;
    attributes->superscript = format.superscript;
    if (format.raisedHalfPoints != 0) {
        attributes->baselineOffset = format.raisedHalfPoints / static_cast<double>(RTFHalfPointsPerPoint);
    }
    if (format.link != 0) {
        const Link& link = links_[static_cast<std::size_t>(format.link) - 1];
        attributes->link = link.address;
        if (!link.toolTip.empty()) attributes->toolTip = link.toolTip;
    }
    if (format.attachment != 0) attributes->attachment = attachments_[static_cast<std::size_t>(format.attachment) - 1];
    attributes->paragraphStyle = paragraphStyle_;
    madeSize_ += estimatedSize(*attributes);
    return *attributes == TextAttributes{} ? nullptr : attributes;
}

}  // namespace plume
