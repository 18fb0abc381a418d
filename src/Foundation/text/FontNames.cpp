#include "Foundation/text/FontNames.h"

#include <algorithm>
#include <array>

namespace plume {

namespace {

// How names of faces end.
struct FaceSuffix {
    std::u16string_view suffix;
    bool bold;
    bool italic;
};

constexpr std::array FaceSuffixes = {
    FaceSuffix{u"-BoldItalic", true, true}, FaceSuffix{u"-BoldOblique", true, true},
    FaceSuffix{u"-Bold", true, false},      FaceSuffix{u"-Italic", false, true},
    FaceSuffix{u"-Oblique", false, true},   FaceSuffix{u"-Regular", false, false},
};

// Families whose faces have names that do not follow from the family's.
struct NamedFamily {
    std::u16string_view family;
    std::u16string_view stem;
    std::array<std::u16string_view, 4> suffixes;  // regular, bold, italic, both
};

using Suffixes = std::array<std::u16string_view, 4>;
constexpr Suffixes Plain = {u"", u"-Bold", u"-Italic", u"-BoldItalic"};
constexpr Suffixes Oblique = {u"", u"-Bold", u"-Oblique", u"-BoldOblique"};
constexpr Suffixes WithMaker = {u"MT", u"-BoldMT", u"-ItalicMT", u"-BoldItalicMT"};
constexpr Suffixes WithFormatAndMaker = {u"PSMT", u"PS-BoldMT", u"PS-ItalicMT", u"PS-BoldItalicMT"};

constexpr std::array NamedFamilies = {
    NamedFamily{u"Arial", u"Arial", WithMaker},
    NamedFamily{u"Comic Sans MS", u"ComicSansMS", Plain},
    NamedFamily{u"Courier", u"Courier", Oblique},
    NamedFamily{u"Courier New", u"CourierNew", WithFormatAndMaker},
    NamedFamily{u"DejaVu Sans", u"DejaVuSans", Oblique},
    NamedFamily{u"DejaVu Sans Mono", u"DejaVuSansMono", Oblique},
    NamedFamily{u"DejaVu Serif", u"DejaVuSerif", Plain},
    NamedFamily{u"Helvetica", u"Helvetica", Oblique},
    NamedFamily{u"Helvetica Neue", u"HelveticaNeue", Plain},
    NamedFamily{u"Liberation Mono", u"LiberationMono", Plain},
    NamedFamily{u"Liberation Sans", u"LiberationSans", Plain},
    NamedFamily{u"Liberation Serif", u"LiberationSerif", Plain},
    NamedFamily{u"Lucida Grande", u"LucidaGrande", Plain},
    NamedFamily{u"Menlo", u"Menlo", {u"-Regular", u"-Bold", u"-Italic", u"-BoldItalic"}},
    NamedFamily{u"Times", u"Times", {u"-Roman", u"-Bold", u"-Italic", u"-BoldItalic"}},
    NamedFamily{u"Times New Roman", u"TimesNewRoman", WithFormatAndMaker},
    NamedFamily{u"Trebuchet MS", u"TrebuchetMS", Plain},
};

FontAttribute face(std::u16string_view family, bool bold, bool italic) {
    FontAttribute font;
    font.family = family;
    font.bold = bold;
    font.italic = italic;
    return font;
}

std::size_t faceIndex(const FontAttribute& font) {
    return (font.bold ? 1U : 0U) + (font.italic ? 2U : 0U);
}

}  // namespace

FontAttribute fontFromFaceName(std::u16string_view name) {
    for (const NamedFamily& known : NamedFamilies) {
        if (!name.starts_with(known.stem)) continue;
        const std::u16string_view rest = name.substr(known.stem.size());
        for (std::size_t i = 0; i < known.suffixes.size(); ++i) {
            if (rest == known.suffixes[i]) return face(known.family, (i & 1U) != 0, (i & 2U) != 0);
        }
    }
    for (const FaceSuffix& known : FaceSuffixes) {
        if (!name.ends_with(known.suffix)) continue;
        const std::u16string_view stem = name.substr(0, name.size() - known.suffix.size());
        const auto named = std::find_if(NamedFamilies.begin(), NamedFamilies.end(),
                                        [&](const NamedFamily& family) { return family.stem == stem; });
        return face(named == NamedFamilies.end() ? stem : named->family, known.bold, known.italic);
    }
    return face(name, false, false);
}

std::u16string faceNameOf(const FontAttribute& font) {
    const auto known = std::find_if(NamedFamilies.begin(), NamedFamilies.end(),
                                    [&](const NamedFamily& named) { return named.family == font.family; });
    if (known != NamedFamilies.end()) return std::u16string(known->stem).append(known->suffixes[faceIndex(font)]);
    std::u16string name = font.family;
    name += Plain[faceIndex(font)];
    // A family may be called what would be a face of another one.
    const FontAttribute read = fontFromFaceName(name);
    if (faceIndex(font) == 0 && (read.family != font.family || faceIndex(read) != 0)) name += u"-Regular";
    return name;
}

}  // namespace plume
