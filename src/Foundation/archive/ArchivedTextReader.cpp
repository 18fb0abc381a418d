#include "Foundation/archive/ArchivedTextReader.h"

#include <algorithm>
#include <charconv>
#include <cmath>
#include <string>
#include <utility>
#include <vector>

#include "Foundation/Strings.h"
#include "Foundation/text/FontNames.h"
#include "Foundation/text/RTFD.h"

namespace plume {

namespace {

constexpr std::size_t CostOfRun = 64;
constexpr std::size_t MostComponents = 5;

// Seven bits a byte, the lowest first; nothing at the end of the bytes, or for a number that is too long.
std::optional<std::size_t> takeLeb128(std::string_view& bytes) {
    std::size_t number = 0;
    for (unsigned shift = 0; shift < 63 && !bytes.empty(); shift += 7) {
        const auto byte = static_cast<unsigned char>(bytes.front());
        bytes.remove_prefix(1);
        number |= static_cast<std::size_t>(byte & 0x7F) << shift;
        if ((byte & 0x80) == 0) return number;
    }
    return std::nullopt;
}

// Numbers from 0 to 1 between spaces; a zero byte may end them.
std::vector<double> componentsOf(std::string_view text) {
    std::vector<double> components;
    const char* position = text.data();
    const char* end = position + text.size();
    while (components.size() < MostComponents) {
        while (position != end && *position == ' ') ++position;
        double component = 0;
        const auto [next, error] = std::from_chars(position, end, component);
        if (error != std::errc()) break;
        components.push_back(std::isfinite(component) ? std::clamp(component, 0.0, 1.0) : 0);
        position = next;
    }
    return components;
}

std::optional<ColorAttribute> rgbOf(const std::vector<double>& parts) {
    if (parts.size() < 3) return std::nullopt;
    return ColorAttribute{parts[0], parts[1], parts[2], parts.size() > 3 ? parts[3] : 1};
}

std::optional<ColorAttribute> grayOf(const std::vector<double>& parts) {
    if (parts.empty()) return std::nullopt;
    return ColorAttribute{parts[0], parts[0], parts[0], parts.size() > 1 ? parts[1] : 1};
}

std::optional<ColorAttribute> cmykOf(const std::vector<double>& parts) {
    if (parts.size() < 4) return std::nullopt;
    const double light = 1 - parts[3];
    return ColorAttribute{(1 - parts[0]) * light, (1 - parts[1]) * light, (1 - parts[2]) * light,
                          parts.size() > 4 ? parts[4] : 1};
}

}  // namespace

template <typename Receive>
void ArchivedTextReader::readRuns(const ArchivedValue& object, std::size_t length, const Receive& receive) {
    const ArchivedValue attributes = archive_.field(object, "NSAttributes");
    const bool isList = archive_.classOf(attributes) == ArchivedClass::Array;
    const auto dictionaries = isList ? archive_.elementsOf(attributes) : std::vector<ArchivedValue>{attributes};
    std::size_t location = 0;
    for (const auto& [runLength, index] : runsOf(object, length)) {
        receive(runLength, attributesOf(index < dictionaries.size() ? dictionaries[index] : ArchivedValue()));
        location += runLength;
    }
    if (location < length) receive(length - location, Attributes());
}

std::optional<ArchivedRichText> ArchivedTextReader::read(const ArchivedValue& object) {
    if (archive_.classOf(object) != ArchivedClass::AttributedString) return std::nullopt;
    ArchivedRichText rich;
    rich.text = archive_.string(archive_.field(object, "NSString")).value_or(u"");
    readRuns(object, rich.text.size(), [&](std::size_t length, const Attributes& run) {
        ArchivedRun& added = rich.runs.emplace_back();
        added.length = length;
        added.attributes = run.attributes;
        if (archive_.spend(run.othersCost)) added.others = run.others;
    });
    return rich;
}

std::optional<AttributedString> ArchivedTextReader::readAttributedString(const ArchivedValue& object) {
    if (archive_.classOf(object) != ArchivedClass::AttributedString) return std::nullopt;
    const std::u16string all = archive_.string(archive_.field(object, "NSString")).value_or(u"");
    AttributedString text;
    readRuns(object, all.size(), [&](std::size_t length, const Attributes& run) {
        text.append(std::u16string_view(all).substr(text.length(), length), run.attributes);
    });
    return text;
}

// Lengths of runs with the numbers of their dictionaries, together at most as long as the text.
std::vector<std::pair<std::size_t, std::size_t>> ArchivedTextReader::runsOf(const ArchivedValue& object,
                                                                            std::size_t length) {
    const auto info = archive_.data(archive_.field(object, "NSAttributeInfo"));
    if (!info) return {{length, 0}};
    std::vector<std::pair<std::size_t, std::size_t>> runs;
    std::string_view bytes = *info;
    while (length > 0 && archive_.spend(CostOfRun)) {
        const auto runLength = takeLeb128(bytes);
        const auto index = takeLeb128(bytes);
        if (!runLength || !index) break;
        const std::size_t taken = std::min(*runLength, length);
        if (taken > 0) runs.emplace_back(taken, *index);
        length -= taken;
    }
    return runs;
}

const ArchivedTextReader::Attributes& ArchivedTextReader::attributesOf(const ArchivedValue& dictionary) {
    const auto known = known_.find(dictionary.place);
    if (known != known_.end()) return known->second;
    Attributes attributes = readAttributes(dictionary);
    if (dictionary.place != 0) return known_.emplace(dictionary.place, std::move(attributes)).first->second;
    return inline_ = std::move(attributes);
}

ArchivedTextReader::Attributes ArchivedTextReader::readAttributes(const ArchivedValue& dictionary) {
    Attributes read;
    auto attributes = std::make_shared<TextAttributes>();
    for (const auto& entry : archive_.entriesOf(dictionary)) {
        const std::string& name = entry.first;
        const ArchivedValue& value = entry.second;
        if (readAttribute(name, value, *attributes)) continue;
        read.othersCost += sizeof(PropertyList) + sizeof(std::u16string);
        if (auto text = archive_.string(value)) {
            read.othersCost += name.size() + text->size() * sizeof(char16_t);
            read.others.insert_or_assign(fromUtf8(name), *std::move(text));
        } else if (const auto number = archive_.number(value)) {
            std::visit([&](auto any) { read.others.insert_or_assign(fromUtf8(name), any); }, *number);
        }
    }
    if (!(*attributes == TextAttributes{})) read.attributes = std::move(attributes);
    return read;
}

// False for a name that is not known.
bool ArchivedTextReader::readAttribute(std::string_view name, const ArchivedValue& value, TextAttributes& attributes) {
    if (name == "NSFont") {
        attributes.font = fontOf(value);
    } else if (name == "NSColor") {
        attributes.foregroundColor = colorOf(value);
    } else if (name == "NSBackgroundColor") {
        attributes.backgroundColor = colorOf(value);
    } else if (name == "NSUnderline") {
        attributes.underlineStyle = archive_.integer(value).value_or(0);
    } else if (name == "NSStrikethrough") {
        attributes.strikethroughStyle = archive_.integer(value).value_or(0);
    } else if (name == "NSSuperScript") {
        attributes.superscript = archive_.integer(value).value_or(0);
    } else if (name == "NSBaselineOffset") {
        attributes.baselineOffset = archive_.real(value);
    } else if (name == "NSLink") {
        attributes.link = archive_.address(value);
    } else if (name == "NSToolTip") {
        attributes.toolTip = archive_.string(value);
    } else if (name == "NSParagraphStyle") {
        attributes.paragraphStyle = paragraphStyleOf(value);
    } else if (name == "NSAttachment") {
        attributes.attachment = attachmentOf(value);
    } else {
        return false;
    }
    return true;
}

std::optional<FontAttribute> ArchivedTextReader::fontOf(const ArchivedValue& object) {
    const auto name = archive_.string(archive_.field(object, "NSName"));
    if (!name) return std::nullopt;
    FontAttribute font = fontFromFaceName(*name);
    if (const auto size = archive_.real(archive_.field(object, "NSSize")); size && std::isfinite(*size)) {
        font.size = *size;
    }
    return font;
}

std::optional<ColorAttribute> ArchivedTextReader::colorOf(const ArchivedValue& object) {
    const auto components = [&](std::string_view key) {
        return componentsOf(archive_.data(archive_.field(object, key)).value_or(std::string()));
    };
    std::optional<ColorAttribute> color;
    // A colour of a catalogue comes with what it looks like.
    if (const ArchivedValue looks = archive_.field(object, "NSColor")) {
        archive_.nested([&] { color = colorOf(looks); });
    }
    if (!color) color = rgbOf(components("NSRGB"));
    if (!color) color = grayOf(components("NSWhite"));
    if (!color) color = cmykOf(components("NSCMYK"));
    if (!color) {
        const auto parts = components("NSComponents");
        color = parts.size() > 4 ? cmykOf(parts) : parts.size() > 2 ? rgbOf(parts) : grayOf(parts);
    }
    return color;
}

std::optional<ParagraphStyle> ArchivedTextReader::paragraphStyleOf(const ArchivedValue& object) {
    if (!object.isDictionary()) return std::nullopt;
    ParagraphStyle style;
    const auto distance = [&](std::string_view key) {
        const double value = archive_.real(archive_.field(object, key)).value_or(0);
        return std::isfinite(value) ? value : 0;
    };
    const std::int64_t alignment = archive_.integer(archive_.field(object, "NSAlignment")).value_or(0);
    style.alignment = alignment >= 0 && alignment <= static_cast<std::int64_t>(TextAlignment::Natural)
                          ? static_cast<TextAlignment>(alignment)
                          : TextAlignment::Natural;
    style.firstLineHeadIndent = distance("NSFirstLineHeadIndent");
    style.headIndent = distance("NSHeadIndent");
    style.tailIndent = distance("NSTailIndent");
    style.lineSpacing = distance("NSLineSpacing");
    style.lineHeightMultiple = distance("NSLineHeightMultiple");
    style.paragraphSpacing = distance("NSParagraphSpacing");
    style.paragraphSpacingBefore = distance("NSParagraphSpacingBefore");
    for (const ArchivedValue& tab : archive_.elementsOf(archive_.field(object, "NSTabStops"))) {
        style.tabStops.push_back(archive_.real(archive_.field(tab, "NSLocation")).value_or(0));
    }
    for (const ArchivedValue& list : archive_.elementsOf(archive_.field(object, "NSTextLists"))) {
        TextList level;
        level.markerFormat = archive_.string(archive_.field(list, "NSMarkerFormat")).value_or(u"");
        level.startingItemNumber = archive_.integer(archive_.field(list, "NSStart")).value_or(1);
        style.textLists.push_back(std::move(level));
    }
    return style;
}

std::shared_ptr<const TextAttachment> ArchivedTextReader::attachmentOf(const ArchivedValue& object) {
    const ArchivedValue wrapper = archive_.field(object, "NSFileWrapper");
    const auto known = attachments_.find(wrapper.place);
    if (known != attachments_.end() && wrapper.place != 0) return known->second;
    const auto container = archive_.data(archive_.field(wrapper, "NSFileWrapperData"));
    if (!container) return nullptr;
    auto attachment = attachmentFromFlatContainer(*container);
    if (!attachment) return nullptr;
    auto shared = std::make_shared<const TextAttachment>(std::move(attachment).value());
    attachments_[wrapper.place] = shared;
    return shared;
}

}  // namespace plume
