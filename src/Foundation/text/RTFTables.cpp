#include "Foundation/text/RTFTables.h"

#include <algorithm>
#include <array>
#include <utility>

#include "Foundation/Strings.h"
#include "Foundation/text/RTFFormats.h"

namespace plume {

namespace {

constexpr std::size_t MaximumComponents = 5;

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

// Some writers name the face instead of the family.
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

// What a level's number format says where no marker is named.
const char16_t* markerOfNumberFormat(int format) {
    switch (format) {
        case 0:
            return u"{decimal}.";
        case 1:
            return u"{upper-roman}.";
        case 2:
            return u"{lower-roman}.";
        case 3:
            return u"{upper-alpha}.";
        case 4:
            return u"{lower-alpha}.";
        case 255:
            return u"";
        default:
            return u"{disc}";
    }
}

}  // namespace

// ---- Code pages ----

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
        constexpr char16_t latinMeaning = u'\u00B7';
        static_assert(static_cast<unsigned char>(SymbolBullet) == latinMeaning);
        std::replace(text.begin() + static_cast<std::ptrdiff_t>(start), text.end(), latinMeaning, u'\u2022');
    }
}

// ---- Fonts ----

void RTFFontTable::select(int number) {
    finishName();
    if (fonts_.size() >= RTFMaximumFonts && !fonts_.contains(number)) return;
    current_ = &fonts_[number];
}

void RTFFontTable::setCodePage(int codePage) {
    if (current_) current_->codePage = codePage;
}

void RTFFontTable::addText(std::u16string_view text) {
    for (const char16_t unit : text) {
        if (unit == u';') {
            finishName();
        } else if (current_) {
            name_.push_back(unit);
        }
    }
}

void RTFFontTable::finishName() {
    if (current_) {
        std::u16string_view name = trimmed(name_);
        for (const FaceSuffix& face : FaceSuffixes) {
            if (name.size() <= face.suffix.size() || !name.ends_with(face.suffix)) continue;
            name.remove_suffix(face.suffix.size());
            current_->bold = face.bold;
            current_->italic = face.italic;
            break;
        }
        current_->family = name;
    }
    name_.clear();
    current_ = nullptr;
}

const RTFFont* RTFFontTable::find(int number) const {
    const auto found = fonts_.find(number);
    return found == fonts_.end() ? nullptr : &found->second;
}

// ---- Colours ----

void RTFColorTable::component(std::size_t index, int value) {
    if (!current_) current_.emplace();
    double& part = index == 0 ? current_->red : index == 1 ? current_->green : current_->blue;
    part = std::clamp(value, 0, 255) / 255.0;
}

void RTFColorTable::beginExpanded(Space space) {
    space_ = space;
    components_.clear();
}

void RTFColorTable::addExpanded(int value) {
    if (components_.size() < MaximumComponents)
        components_.push_back(std::clamp(value, 0, RTFExpandedColorUnits) / static_cast<double>(RTFExpandedColorUnits));
}

void RTFColorTable::finishExpanded() {
    const std::size_t colorants = space_ == Space::Gray ? 1 : 3;
    if (!space_ || components_.size() < colorants) {
        expanded_.emplace_back();
    } else {
        ColorAttribute color{components_[0], components_[colorants / 2], components_[colorants - 1], 1};
        if (components_.size() > colorants) color.alpha = components_[colorants];
        expanded_.emplace_back(color);
    }
    space_.reset();
    components_.clear();
}

void RTFColorTable::addText(std::u16string_view text, bool expanded) {
    for (const char16_t unit : text) {
        Entries& entries = expanded ? expanded_ : colors_;
        if (unit != u';' || entries.size() >= RTFMaximumColors) continue;
        if (expanded) {
            finishExpanded();
        } else {
            colors_.push_back(std::exchange(current_, std::nullopt));
        }
    }
}

std::optional<ColorAttribute> RTFColorTable::find(int index) const {
    const auto place = static_cast<std::size_t>(index);
    if (index < 0 || place >= colors_.size() || !colors_[place]) return std::nullopt;
    if (place < expanded_.size() && expanded_[place]) return expanded_[place];
    return colors_[place];
}

// ---- Lists ----

void RTFListTable::beginList() {
    if (lists_.size() < RTFMaximumLists) lists_.emplace_back();
}

void RTFListTable::beginLevel() {
    if (!lists_.empty() && lists_.back().size() <= RTFDeepestListLevel) lists_.back().push_back({u"{disc}", 1});
}

TextList* RTFListTable::currentLevel() {
    return lists_.empty() || lists_.back().empty() ? nullptr : &lists_.back().back();
}

void RTFListTable::setNumberFormat(int format) {
    if (TextList* level = currentLevel()) level->markerFormat = markerOfNumberFormat(format);
}

void RTFListTable::setStart(int start) {
    if (TextList* level = currentLevel()) level->startingItemNumber = start;
}

void RTFListTable::setMarker(std::u16string marker) {
    if (TextList* level = currentLevel()) level->markerFormat = std::move(marker);
}

void RTFListTable::setIdentifier(int identifier) {
    if (!lists_.empty() && byIdentifier_.size() < RTFMaximumLists) byIdentifier_[identifier] = lists_.size() - 1;
}

void RTFListTable::addOverride(int number) {
    const auto list = byIdentifier_.find(override_);
    if (list != byIdentifier_.end() && byNumber_.size() < RTFMaximumLists) byNumber_[number] = list->second;
}

std::vector<TextList> RTFListTable::listsAt(int number, int level) const {
    const auto list = byNumber_.find(number);
    if (list == byNumber_.end()) return {};
    const auto& levels = lists_[list->second];
    const std::size_t count = std::min(levels.size(), static_cast<std::size_t>(std::max(level, 0)) + 1);
    return {levels.begin(), levels.begin() + static_cast<std::ptrdiff_t>(count)};
}

}  // namespace plume
