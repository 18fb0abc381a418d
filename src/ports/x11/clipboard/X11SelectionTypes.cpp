#include "ports/x11/clipboard/X11SelectionTypes.h"

#include <algorithm>
#include <array>

#include "Foundation/Strings.h"
#include "platform/Pasteboard.h"

namespace plume {

namespace {

constexpr std::array TextTargets = {SelectionTarget::Utf8String, SelectionTarget::Utf8Text, SelectionTarget::PlainText,
                                    SelectionTarget::Latin1String};
constexpr std::array RtfTargets = {SelectionTarget::TextRtf, SelectionTarget::ApplicationRtf};
constexpr std::array HtmlTargets = {SelectionTarget::TextHtml};
constexpr std::array MappedTypes = {PasteboardType::String, PasteboardType::RTF, PasteboardType::HTML};

constexpr std::array<std::string_view, 7> MetaTargets = {
    "TARGETS", "TIMESTAMP", "MULTIPLE", "SAVE_TARGETS", "DELETE", "INSERT_SELECTION", "INSERT_PROPERTY"};

}  // namespace

std::span<const std::string_view> targetsOfType(std::string_view type) {
    if (type == PasteboardType::String) return TextTargets;
    if (type == PasteboardType::RTF) return RtfTargets;
    if (type == PasteboardType::HTML) return HtmlTargets;
    return {};
}

std::optional<std::string_view> typeOfTarget(std::string_view target) {
    for (const std::string_view type : MappedTypes) {
        const auto targets = targetsOfType(type);
        if (std::find(targets.begin(), targets.end(), target) != targets.end()) return type;
    }
    return std::nullopt;
}

bool isMetaTarget(std::string_view target) {
    return std::find(MetaTargets.begin(), MetaTargets.end(), target) != MetaTargets.end();
}

std::vector<std::string> typesOfTargets(const std::vector<std::string>& targets) {
    std::vector<std::string> types;
    for (const std::string& target : targets) {
        if (isMetaTarget(target) || std::find(types.begin(), types.end(), target) != types.end()) continue;
        const auto type = typeOfTarget(target);
        if (type && targetForType(*type, targets) == target) types.emplace_back(*type);
        types.push_back(target);
    }
    return types;
}

std::string_view targetForType(std::string_view type, std::span<const std::string> targets) {
    for (const std::string_view wanted : targetsOfType(type)) {
        const auto found = std::find(targets.begin(), targets.end(), wanted);
        if (found != targets.end()) return *found;
    }
    const auto own = std::find(targets.begin(), targets.end(), type);
    return own == targets.end() ? std::string_view() : *own;
}

std::string latin1FromUtf8(std::string_view text) {
    std::string latin1;
    latin1.reserve(text.size());
    bool afterLead = false;
    for (const char16_t unit : fromUtf8(text)) {
        const bool isTrail = afterLead && (unit & 0xFC00) == 0xDC00;
        afterLead = (unit & 0xFC00) == 0xD800;
        if (!isTrail) latin1.push_back(unit <= 0xFF ? static_cast<char>(unit) : '?');
    }
    return latin1;
}

std::string utf8FromLatin1(std::string_view text) {
    std::u16string units;
    units.reserve(text.size());
    for (const char byte : text) units.push_back(static_cast<unsigned char>(byte));
    return toUtf8(units);
}

}  // namespace plume
