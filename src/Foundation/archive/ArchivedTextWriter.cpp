#include "Foundation/archive/ArchivedTextWriter.h"

#include <array>
#include <charconv>
#include <cstdint>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "Foundation/text/FontNames.h"
#include "Foundation/text/RTFD.h"

namespace plume {

namespace {

using Class = ArchiveWriter::Class;

constexpr Class AttributedStringClass{"NSAttributedString"};
constexpr Class FontClass{"NSFont"};
constexpr Class ColorClass{"NSColor"};
constexpr Class UrlClass{"NSURL"};
constexpr Class ParagraphStyleClass{"NSParagraphStyle"};
constexpr Class TextTabClass{"NSTextTab"};
constexpr Class TextListClass{"NSTextList"};
constexpr Class TextAttachmentClass{"NSTextAttachment"};
constexpr Class FileWrapperClass{"NSFileWrapper"};
constexpr Class MutableDataClass{"NSMutableData", "NSData"};

constexpr std::int64_t UsualFontFlags = 16;
constexpr std::int64_t CalibratedRgb = 1;

// Seven bits a byte, the lowest first; all but the last byte have their highest bit set.
void appendLeb128(std::string& bytes, std::size_t number) {
    for (; number > 0x7F; number >>= 7) bytes.push_back(static_cast<char>(0x80 | (number & 0x7F)));
    bytes.push_back(static_cast<char>(number));
}

void appendComponent(std::string& bytes, double component) {
    std::array<char, 32> text{};
    const auto end = std::to_chars(text.data(), text.data() + text.size(), component).ptr;
    if (!bytes.empty()) bytes.push_back(' ');
    bytes.append(text.data(), end);
}

bool isHexDigit(char16_t unit) {
    return (unit >= u'0' && unit <= u'9') || (unit >= u'A' && unit <= u'F') || (unit >= u'a' && unit <= u'f');
}

// Whether the platform's addresses can hold a link; others are kept as strings.
bool isAddress(std::u16string_view link) {
    constexpr std::u16string_view Refused = u"\"<>[\\]^`{|}";
    for (std::size_t i = 0; i < link.size(); ++i) {
        const char16_t unit = link[i];
        if (unit <= u' ' || unit >= 0x7F || Refused.find(unit) != std::u16string_view::npos) return false;
        const bool isEscape = i + 2 < link.size() && isHexDigit(link[i + 1]) && isHexDigit(link[i + 2]);
        if (unit == u'%' && !isEscape) return false;
    }
    return !link.empty();
}

}  // namespace

ArchivedTextWriter::Object ArchivedTextWriter::add(const AttributedString& text) {
    Fields fields(archive_);
    fields.refer("NSString", archive_.addString(text.string()));
    if (!text.isEmpty()) addRuns(fields, text.runs());
    return archive_.add(AttributedStringClass, fields);
}

void ArchivedTextWriter::addRuns(Fields& fields, const std::vector<AttributedString::Run>& runs) {
    if (runs.size() == 1) {
        fields.refer("NSAttributes", addAttributes(runs.front().attributes));
        return;
    }
    std::vector<Object> dictionaries;
    std::map<Object, std::size_t> places;
    std::string info;
    for (const AttributedString::Run& run : runs) {
        const Object dictionary = addAttributes(run.attributes);
        const auto [place, isNew] = places.emplace(dictionary, dictionaries.size());
        if (isNew) dictionaries.push_back(dictionary);
        appendLeb128(info, run.length);
        appendLeb128(info, place->second);
    }
    fields.refer("NSAttributes", archive_.addArray(archived::MutableArray, dictionaries));
    fields.refer("NSAttributeInfo", addMutableData(info));
}

ArchivedTextWriter::Object ArchivedTextWriter::addAttributes(const SharedAttributes& attributes) {
    if (!attributes) return archive_.addDictionary({});
    const auto known = known_.find(attributes);
    if (known != known_.end()) return known->second;
    return known_.emplace(attributes, addAttributes(*attributes)).first->second;
}

ArchivedTextWriter::Object ArchivedTextWriter::addAttributes(const TextAttributes& attributes) {
    BinaryObjectWriter& values = archive_.values();
    std::vector<std::pair<Object, Object>> entries;
    const auto put = [&](std::string_view name, Object object) {
        entries.emplace_back(archive_.add(values.ascii(name)), object);
    };
    const auto putNumber = [&](std::string_view name, std::int64_t number) {
        if (number != 0) put(name, archive_.add(values.integer(number)));
    };
    if (attributes.font) put("NSFont", addFont(*attributes.font));
    if (attributes.foregroundColor) put("NSColor", addColor(*attributes.foregroundColor));
    if (attributes.backgroundColor) put("NSBackgroundColor", addColor(*attributes.backgroundColor));
    putNumber("NSUnderline", attributes.underlineStyle);
    putNumber("NSStrikethrough", attributes.strikethroughStyle);
    putNumber("NSSuperScript", attributes.superscript);
    if (attributes.baselineOffset) put("NSBaselineOffset", archive_.add(values.real(*attributes.baselineOffset)));
    if (attributes.link) put("NSLink", addLink(*attributes.link));
    if (attributes.toolTip) put("NSToolTip", archive_.addString(*attributes.toolTip));
    if (attributes.paragraphStyle) put("NSParagraphStyle", addParagraphStyle(*attributes.paragraphStyle));
    if (attributes.attachment) put("NSAttachment", addAttachment(*attributes.attachment));
    return archive_.addDictionary(entries);
}

ArchivedTextWriter::Object ArchivedTextWriter::addFont(const FontAttribute& font) {
    Fields fields(archive_);
    fields.refer("NSName", archive_.addString(faceNameOf(font)));
    fields.put("NSSize", archive_.values().real(font.size));
    fields.put("NSfFlags", archive_.values().integer(UsualFontFlags));
    return archive_.add(FontClass, fields);
}

ArchivedTextWriter::Object ArchivedTextWriter::addColor(const ColorAttribute& color) {
    std::string components;
    for (const double component : {color.red, color.green, color.blue}) appendComponent(components, component);
    if (color.alpha != 1) appendComponent(components, color.alpha);
    components.push_back('\0');
    Fields fields(archive_);
    fields.put("NSColorSpace", archive_.values().integer(CalibratedRgb));
    fields.put("NSRGB", archive_.values().data(components));
    return archive_.add(ColorClass, fields);
}

ArchivedTextWriter::Object ArchivedTextWriter::addLink(const std::u16string& link) {
    const Object text = archive_.addString(link);
    if (!isAddress(link)) return text;
    Fields fields(archive_);
    fields.refer("NS.base", 0).refer("NS.relative", text);
    return archive_.add(UrlClass, fields);
}

ArchivedTextWriter::Object ArchivedTextWriter::addParagraphStyle(const ParagraphStyle& style) {
    Fields fields(archive_);
    if (style.alignment != TextAlignment::Left) {
        fields.put("NSAlignment", archive_.values().integer(static_cast<std::int64_t>(style.alignment)));
    }
    const std::pair<std::string_view, double> distances[] = {
        {"NSFirstLineHeadIndent", style.firstLineHeadIndent},
        {"NSHeadIndent", style.headIndent},
        {"NSTailIndent", style.tailIndent},
        {"NSLineSpacing", style.lineSpacing},
        {"NSLineHeightMultiple", style.lineHeightMultiple},
        {"NSParagraphSpacing", style.paragraphSpacing},
        {"NSParagraphSpacingBefore", style.paragraphSpacingBefore},
    };
    for (const auto& [key, distance] : distances) {
        if (distance != 0) fields.put(key, archive_.values().real(distance));
    }
    fields.refer("NSTabStops", style.tabStops.empty() ? 0 : addTabStops(style.tabStops));
    if (!style.textLists.empty()) fields.refer("NSTextLists", addTextLists(style.textLists));
    return archive_.add(ParagraphStyleClass, fields);
}

ArchivedTextWriter::Object ArchivedTextWriter::addTabStops(const std::vector<double>& locations) {
    std::vector<Object> tabs;
    for (const double location : locations) {
        Fields fields(archive_);
        tabs.push_back(archive_.add(TextTabClass, fields.put("NSLocation", archive_.values().real(location))));
    }
    return archive_.addArray(archived::Array, tabs);
}

ArchivedTextWriter::Object ArchivedTextWriter::addTextLists(const std::vector<TextList>& lists) {
    std::vector<Object> objects;
    for (const TextList& list : lists) {
        Fields fields(archive_);
        fields.refer("NSMarkerFormat", archive_.addString(list.markerFormat));
        if (list.startingItemNumber != 1) {
            fields.put("NSStart", archive_.values().integer(list.startingItemNumber));
        }
        objects.push_back(archive_.add(TextListClass, fields));
    }
    return archive_.addArray(archived::Array, objects);
}

ArchivedTextWriter::Object ArchivedTextWriter::addAttachment(const TextAttachment& attachment) {
    Fields wrapper(archive_);
    wrapper.refer("NSFileWrapperData", addMutableData(flatContainerFromAttachment(attachment)));
    const Object file = archive_.add(FileWrapperClass, wrapper);
    Fields fields(archive_);
    return archive_.add(TextAttachmentClass, fields.refer("NSFileWrapper", file));
}

ArchivedTextWriter::Object ArchivedTextWriter::addMutableData(const std::string& bytes) {
    Fields fields(archive_);
    return archive_.add(MutableDataClass, fields.put("NS.data", archive_.values().data(bytes)));
}

}  // namespace plume
