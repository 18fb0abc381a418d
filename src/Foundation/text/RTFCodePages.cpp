#include "Foundation/text/RTFCodePages.h"

#include <algorithm>
#include <array>

namespace plume {

namespace {

// Bytes of symbol fonts are glyph numbers, not characters. The bullet of lists is the one that text needs.
constexpr int SymbolCodePage = 42;
constexpr char SymbolBullet = '\xB7';

struct CodePageName {
    int codePage;
    const char* name;
};

constexpr std::array CodePageNames = {
    CodePageName{437, "ibm-437"},          CodePageName{850, "ibm-850"},
    CodePageName{852, "ibm-852"},          CodePageName{866, "ibm-866"},
    CodePageName{874, "windows-874"},      CodePageName{932, "windows-932"},
    CodePageName{936, "windows-936"},      CodePageName{949, "windows-949"},
    CodePageName{950, "windows-950"},      CodePageName{1250, "windows-1250"},
    CodePageName{1251, "windows-1251"},    CodePageName{1252, "windows-1252"},
    CodePageName{1253, "windows-1253"},    CodePageName{1254, "windows-1254"},
    CodePageName{1255, "windows-1255"},    CodePageName{1256, "windows-1256"},
    CodePageName{1257, "windows-1257"},    CodePageName{1258, "windows-1258"},
    CodePageName{10000, "macintosh"},      CodePageName{10006, "x-mac-greek"},
    CodePageName{10007, "x-mac-cyrillic"}, CodePageName{10029, "x-mac-centraleurroman"},
    CodePageName{10081, "x-mac-turkish"},  CodePageName{65001, "UTF-8"},
};

struct CharacterSetPage {
    int characterSet;
    int codePage;
};

constexpr std::array CharacterSetPages = {
    CharacterSetPage{2, SymbolCodePage}, CharacterSetPage{77, 10000}, CharacterSetPage{78, 932},
    CharacterSetPage{79, 949},           CharacterSetPage{80, 936},   CharacterSetPage{81, 950},
    CharacterSetPage{85, 10006},         CharacterSetPage{86, 10081}, CharacterSetPage{88, 10029},
    CharacterSetPage{89, 10007},         CharacterSetPage{128, 932},  CharacterSetPage{129, 949},
    CharacterSetPage{134, 936},          CharacterSetPage{136, 950},  CharacterSetPage{161, 1253},
    CharacterSetPage{162, 1254},         CharacterSetPage{163, 1258}, CharacterSetPage{177, 1255},
    CharacterSetPage{178, 1256},         CharacterSetPage{186, 1257}, CharacterSetPage{204, 1251},
    CharacterSetPage{222, 874},          CharacterSetPage{238, 1250}, CharacterSetPage{254, 437},
    CharacterSetPage{255, 850},
};

}  // namespace

int RTFCodePages::codePageOfCharacterSet(int characterSet) {
    const auto found = std::find_if(CharacterSetPages.begin(), CharacterSetPages.end(),
                                    [&](const CharacterSetPage& page) { return page.characterSet == characterSet; });
    return found == CharacterSetPages.end() ? 0 : found->codePage;
}

bool RTFCodePages::isKnown(int codePage) {
    return std::any_of(CodePageNames.begin(), CodePageNames.end(),
                       [&](const CodePageName& page) { return page.codePage == codePage; });
}

UConverter* RTFCodePages::converterFor(int codePage) {
    if (!isKnown(codePage)) codePage = RTFLatinCodePage;
    auto& converter = converters_[codePage];
    if (!converter) {
        const auto page = std::find_if(CodePageNames.begin(), CodePageNames.end(),
                                       [&](const CodePageName& known) { return known.codePage == codePage; });
        UErrorCode status = U_ZERO_ERROR;
        converter.reset(ucnv_open(page->name, &status));
    }
    return converter.get();
}

void RTFCodePages::appendText(int codePage, std::string_view bytes, std::u16string& text) {
    UConverter* converter = converterFor(codePage);
    if (converter == nullptr) {
        text.append(bytes.size(), u'\uFFFD');
        return;
    }
    const std::size_t start = text.size();
    text.resize(start + bytes.size() * 2);
    char16_t* target = text.data() + start;
    const char* source = bytes.data();
    UErrorCode status = U_ZERO_ERROR;
    ucnv_resetToUnicode(converter);
    ucnv_toUnicode(converter, &target, text.data() + text.size(), &source, bytes.data() + bytes.size(), nullptr, true,
                   &status);
    text.resize(static_cast<std::size_t>(target - text.data()));
    // Some pages have a control character of their own for what they cannot convert.
    std::replace(text.begin() + static_cast<std::ptrdiff_t>(start), text.end(), u'\u001A', u'\uFFFD');
    if (codePage == SymbolCodePage) {
        constexpr char16_t LatinMeaning = u'\u00B7';
        static_assert(static_cast<unsigned char>(SymbolBullet) == LatinMeaning);
        std::replace(text.begin() + static_cast<std::ptrdiff_t>(start), text.end(), LatinMeaning, u'\u2022');
    }
}

}  // namespace plume
