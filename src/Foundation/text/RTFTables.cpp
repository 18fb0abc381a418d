#include "Foundation/text/RTFTables.h"

#include <algorithm>
#include <cmath>
#include <limits>
#include <tuple>
#include <utility>

#include "Foundation/Strings.h"
#include "Foundation/text/FontNames.h"
#include "Foundation/text/RTFFormats.h"

namespace plume {

namespace {

constexpr std::size_t MaximumComponents = 5;

constexpr int BulletNumberFormat = 23;
constexpr int EmptyNumberFormat = 255;
constexpr std::size_t LongestWrittenMarker = 8;

// How attributes name the marker of a list's level, and the number format that stands for it.
struct Marker {
    std::u16string_view name;
    int numberFormat;
    std::u16string_view bullet;
};

constexpr std::array Markers = {
    Marker{u"{decimal}", 0, {}},
    Marker{u"{upper-roman}", 1, {}},
    Marker{u"{lower-roman}", 2, {}},
    Marker{u"{upper-alpha}", 3, {}},
    Marker{u"{upper-latin}", 3, {}},
    Marker{u"{lower-alpha}", 4, {}},
    Marker{u"{lower-latin}", 4, {}},
    Marker{u"{disc}", BulletNumberFormat, u"\u2022"},
    Marker{u"{circle}", BulletNumberFormat, u"\u25E6"},
    Marker{u"{square}", BulletNumberFormat, u"\u25AA"},
    Marker{u"{box}", BulletNumberFormat, u"\u25A1"},
    Marker{u"{check}", BulletNumberFormat, u"\u2713"},
    Marker{u"{diamond}", BulletNumberFormat, u"\u25C6"},
    Marker{u"{hyphen}", BulletNumberFormat, u"\u2043"},
};

// What a level's number format says where no marker is named.
std::u16string markerOfNumberFormat(int format) {
    if (format == EmptyNumberFormat) return {};
    const auto found =
        std::find_if(Markers.begin(), Markers.end(), [&](const Marker& m) { return m.numberFormat == format; });
    if (found == Markers.end() || format == BulletNumberFormat) return u"{disc}";
    return std::u16string(found->name) + u".";
}

// The component as its nearest byte says it, when that is exact; else to the precision of the extended table.
double roundedComponent(double component) {
    if (!(component > 0)) return 0;
    if (component >= 1) return 1;
    const double asByte = std::round(component * 255) / 255;
    if (std::abs(asByte - component) < 1e-9) return asByte;
    return std::round(component * RTFExpandedColorUnits) / RTFExpandedColorUnits;
}

int byteOf(double component) {
    return static_cast<int>(std::lround(component * 255));
}

int expandedUnitsOf(double component) {
    return static_cast<int>(std::lround(component * RTFExpandedColorUnits));
}

bool fitsBytes(const std::array<double, 4>& color) {
    return color[3] == 1 && std::all_of(color.begin(), color.end(),
                                        [](double component) { return byteOf(component) / 255.0 == component; });
}

// How a level's marker is drawn by readers that do not know its name: text with the place of the number.
struct LevelText {
    int numberFormat = BulletNumberFormat;
    std::u16string_view before;
    bool hasNumber = false;
    std::u16string_view after;
};

LevelText levelTextOf(std::u16string_view markerFormat) {
    if (markerFormat.size() > RTFMaximumMarkerLength) markerFormat = markerFormat.substr(0, RTFMaximumMarkerLength);
    for (const Marker& marker : Markers) {
        const std::size_t place = markerFormat.find(marker.name);
        if (place == std::u16string_view::npos) continue;
        if (marker.numberFormat == BulletNumberFormat) return {BulletNumberFormat, marker.bullet, false, {}};
        return {marker.numberFormat, markerFormat.substr(0, place), true,
                markerFormat.substr(place + marker.name.size())};
    }
    const bool isShort = markerFormat.size() <= LongestWrittenMarker;
    return {BulletNumberFormat, isShort ? markerFormat : u"\u2022", false, {}};
}

void writeLevelText(RTFOutput& output, const LevelText& level, unsigned char depth) {
    const std::size_t length = level.before.size() + level.after.size() + (level.hasNumber ? 1 : 0);
    output.openGroup();
    output.control("leveltext");
    output.byte(static_cast<unsigned char>(length));
    output.text(level.before);
    if (level.hasNumber) output.byte(depth);
    output.text(level.after);
    output.text(u";");
    output.closeGroup();
    output.openGroup();
    output.control("levelnumbers");
    if (level.hasNumber) output.byte(static_cast<unsigned char>(level.before.size() + 1));
    output.text(u";");
    output.closeGroup();
}

void writeLevel(RTFOutput& output, const TextList& list, unsigned char depth) {
    constexpr std::int64_t Largest = std::numeric_limits<int>::max();
    const LevelText level = levelTextOf(list.markerFormat);
    output.openGroup();
    output.control("listlevel");
    output.control("levelnfc", level.numberFormat);
    output.control("levelnfcn", level.numberFormat);
    output.control("leveljc", 0);
    output.control("leveljcn", 0);
    output.control("levelfollow", 0);
    output.control("levelstartat", static_cast<int>(std::clamp(list.startingItemNumber, -Largest, Largest)));
    output.openGroup();
    output.ignorableControl("levelmarker");
    output.text(list.markerFormat);
    output.closeGroup();
    writeLevelText(output, level, depth);
    output.closeGroup();
}

}  // namespace

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
        // Some writers name the face instead of the family.
        const FontAttribute font = fontFromFaceName(trimmed(name_));
        current_->bold = current_->bold || font.bold;
        current_->italic = current_->italic || font.italic;
        current_->family = font.family;
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

// ---- Written tables ----

bool RTFTableWriter::LevelsBefore::operator()(const std::vector<TextList>& a, const std::vector<TextList>& b) const {
    return std::lexicographical_compare(a.begin(), a.end(), b.begin(), b.end(), [](const auto& x, const auto& y) {
        return std::tie(x.markerFormat, x.startingItemNumber) < std::tie(y.markerFormat, y.startingItemNumber);
    });
}

int RTFTableWriter::fontNumber(const std::u16string& family) {
    std::u16string name = family;
    std::erase_if(name, [](char16_t unit) { return unit < u' ' || unit == u';'; });
    name = trimmed(name);
    if (name.empty()) return -1;
    if (fontNumbers_.size() >= RTFMaximumFonts && !fontNumbers_.contains(name)) return -1;
    return fontNumbers_.emplace(std::move(name), static_cast<int>(fontNumbers_.size())).first->second;
}

int RTFTableWriter::colorIndex(const ColorAttribute& color) {
    const Components components{roundedComponent(color.red), roundedComponent(color.green),
                                roundedComponent(color.blue), roundedComponent(color.alpha)};
    const auto known = colorIndices_.find(components);
    if (known != colorIndices_.end()) return known->second;
    // Index 0 stands for the automatic colour.
    if (colors_.size() + 1 >= RTFMaximumColors) return 0;
    colors_.push_back(components);
    return colorIndices_.emplace(components, static_cast<int>(colors_.size())).first->second;
}

int RTFTableWriter::listNumber(const std::vector<TextList>& levels) {
    if (levels.empty()) return 0;
    constexpr std::size_t Deepest = RTFDeepestListLevel + 1;
    const std::vector<TextList> written(levels.begin(),
                                        levels.begin() + static_cast<std::ptrdiff_t>(std::min(levels.size(), Deepest)));
    if (listNumbers_.size() >= RTFMaximumLists && !listNumbers_.contains(written)) return 0;
    return listNumbers_.emplace(written, static_cast<int>(listNumbers_.size()) + 1).first->second;
}

void RTFTableWriter::write(RTFOutput& output) const {
    if (!fontNumbers_.empty()) writeFonts(output);
    if (!colors_.empty()) writeColors(output);
    if (!std::all_of(colors_.begin(), colors_.end(), fitsBytes)) writeExpandedColors(output);
    if (!listNumbers_.empty()) writeLists(output);
}

void RTFTableWriter::writeFonts(RTFOutput& output) const {
    output.newline();
    output.openGroup();
    output.control("fonttbl");
    for (const auto& [name, number] : fontNumbers_) {
        output.openGroup();
        output.control("f", number);
        output.control("fnil");
        output.control("fcharset", 0);
        output.text(name);
        output.text(u";");
        output.closeGroup();
    }
    output.closeGroup();
}

void RTFTableWriter::writeColors(RTFOutput& output) const {
    output.newline();
    output.openGroup();
    output.control("colortbl");
    output.text(u";");
    for (const Components& color : colors_) {
        output.control("red", byteOf(color[0]));
        output.control("green", byteOf(color[1]));
        output.control("blue", byteOf(color[2]));
        output.text(u";");
    }
    output.closeGroup();
}

void RTFTableWriter::writeExpandedColors(RTFOutput& output) const {
    output.newline();
    output.openGroup();
    output.ignorableControl("expandedcolortbl");
    output.text(u";");
    for (const Components& color : colors_) {
        if (!fitsBytes(color)) {
            output.control("cssrgb");
            const std::size_t count = color[3] == 1 ? 3 : 4;
            for (std::size_t i = 0; i < count; ++i) output.control("c", expandedUnitsOf(color[i]));
        }
        output.text(u";");
    }
    output.closeGroup();
}

void RTFTableWriter::writeLists(RTFOutput& output) const {
    output.newline();
    output.openGroup();
    output.ignorableControl("listtable");
    for (const auto& [levels, number] : listNumbers_) {
        output.openGroup();
        output.control("list");
        output.control("listtemplateid", number);
        output.control("listhybrid");
        unsigned char depth = 0;
        for (const TextList& level : levels) writeLevel(output, level, depth++);
        output.control("listid", number);
        output.closeGroup();
    }
    output.closeGroup();
    output.newline();
    output.openGroup();
    output.ignorableControl("listoverridetable");
    for (const auto& [levels, number] : listNumbers_) {
        output.openGroup();
        output.control("listoverride");
        output.control("listid", number);
        output.control("listoverridecount", 0);
        output.control("ls", number);
        output.closeGroup();
    }
    output.closeGroup();
}

}  // namespace plume
