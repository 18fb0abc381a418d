// What the tests of rich text have in common.
#pragma once

#include <cmath>
#include <functional>
#include <memory>
#include <string>
#include <utility>

#include "Foundation/Strings.h"
#include "Foundation/text/AttributedString.h"

namespace plume {

// The attributes of the unit at `index`, or none.
inline TextAttributes attributesAt(const AttributedString& text, std::size_t index) {
    const SharedAttributes attributes = text.attributesAt(index);
    return attributes ? *attributes : TextAttributes{};
}

inline AttributedString attributed(std::u16string text, const std::function<void(TextAttributes&)>& set) {
    auto attributes = std::make_shared<TextAttributes>();
    set(*attributes);
    return AttributedString(std::move(text), attributes);
}

inline std::shared_ptr<const TextAttachment> attachment(std::u16string name, std::string contents) {
    return std::make_shared<const TextAttachment>(TextAttachment{std::move(name), std::move(contents), {}});
}

// What a reader sees of the attributes, fonts and distances apart: "bold red", in percent "100.0.20.100".
inline std::string lookOf(const TextAttributes& look) {
    std::string names;
    const auto add = [&](bool has, const std::string& name) {
        if (has) names += (names.empty() ? "" : " ") + name;
    };
    const auto named = [](const ColorAttribute& color) {
        std::string name;
        for (const double part : {color.red, color.green, color.blue, color.alpha}) {
            name += (name.empty() ? "" : ".") + std::to_string(std::lround(100 * part));
        }
        return name == "100.0.0.100" ? "red" : name == "100.100.0.100" ? "yellow" : name;
    };
    add(look.font && look.font->bold, "bold");
    add(look.font && look.font->italic, "italic");
    add(look.underlineStyle != 0, look.underlineStyle == 9 ? "underlined twice" : "underlined");
    add(look.strikethroughStyle != 0, look.strikethroughStyle == 9 ? "struck twice" : "struck");
    add(look.superscript != 0, look.superscript > 0 ? "raised" : "lowered");
    if (look.baselineOffset) add(true, "shifted " + std::to_string(std::lround(10 * *look.baselineOffset)));
    if (look.foregroundColor) add(true, named(*look.foregroundColor));
    if (look.backgroundColor) add(true, "on " + named(*look.backgroundColor));
    if (look.link) add(true, "-> " + toUtf8(*look.link));
    if (look.toolTip) add(true, "(" + toUtf8(*look.toolTip) + ")");
    if (!look.paragraphStyle) return names;
    constexpr const char* Alignments[] = {"left", "right", "centred", "justified", ""};
    const auto alignment = static_cast<std::size_t>(look.paragraphStyle->alignment);
    add(alignment != 0 && alignment != 4, Alignments[alignment]);
    for (const TextList& list : look.paragraphStyle->textLists) {
        add(true,
            toUtf8(list.markerFormat) + (list.startingItemNumber == 1 ? "" : std::to_string(list.startingItemNumber)));
    }
    return names;
}

// "text<look>text…", neighbours that look the same to a reader joined.
inline std::string shown(const AttributedString& text) {
    std::string all;
    std::string last;
    std::size_t position = 0;
    for (const auto& run : text.runs()) {
        const std::string look = run.attributes ? lookOf(*run.attributes) : "";
        if (position > 0 && look != last) all += "<" + last + ">";
        all += toUtf8(text.string().substr(position, run.length));
        last = look;
        position += run.length;
    }
    return all + "<" + last + ">";
}

}  // namespace plume
