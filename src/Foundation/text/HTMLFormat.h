// What text within HTML elements looks like, as far as elements, attributes and inline styles say it.
#pragma once

#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "Foundation/text/TextAttributes.h"

namespace plume {

// Inherited from element to element. Distances are in points.
struct HTMLFormat {
    std::u16string family;  // empty: nobody said
    double size = 0;        // 0: nobody said
    bool bold = false;
    bool italic = false;
    bool underlined = false;
    bool struckThrough = false;
    int superscript = 0;
    std::optional<ColorAttribute> color;
    std::optional<ColorAttribute> background;
    std::u16string link;
    bool preformatted = false;
    bool hidden = false;
    ParagraphStyle paragraph;
};

// Without attributes at all where nothing is said.
SharedAttributes attributesOf(const HTMLFormat& format);

// What the element looks like without any style; `tag` in lower case.
void applyElement(std::string_view tag, HTMLFormat& format);
// The declarations of a "style" attribute; unknown ones are passed over.
void applyStyle(std::string_view css, HTMLFormat& format);
// Attributes of elements that are older than styles: "color", "face", "size" of fonts, "align", "bgcolor".
void applyAttribute(std::string_view tag, std::string_view name, std::string_view value, HTMLFormat& format);

}  // namespace plume
