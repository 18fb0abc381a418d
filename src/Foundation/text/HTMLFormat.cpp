#include "Foundation/text/HTMLFormat.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <memory>
#include <utility>

#include "Foundation/Strings.h"

namespace plume {

namespace {

constexpr double DefaultSize = 12;
constexpr double LargestSize = 1000;
constexpr double PointsPerPixel = 0.75;
constexpr double QuoteIndent = 30;
constexpr std::size_t LongestFamily = 128;

using Format = HTMLFormat;

template <typename Value, std::size_t count>
using Table = std::array<std::pair<std::string_view, Value>, count>;

template <typename Value, std::size_t count>
const Value* find(const Table<Value, count>& table, std::string_view name) {
    const auto found = std::find_if(table.begin(), table.end(), [&](const auto& row) { return row.first == name; });
    return found == table.end() ? nullptr : &found->second;
}

std::string_view withoutSpace(std::string_view text) {
    constexpr std::string_view Space = " \t\r\n\f";
    const std::size_t first = text.find_first_not_of(Space);
    if (first == std::string_view::npos) return {};
    return text.substr(first, text.find_last_not_of(Space) - first + 1);
}

std::string lower(std::string_view text) {
    std::string result(text);
    std::transform(result.begin(), result.end(), result.begin(),
                   [](char c) { return c >= 'A' && c <= 'Z' ? static_cast<char>(c - 'A' + 'a') : c; });
    return result;
}

// The number that the text begins with, which is taken from it.
std::optional<double> takeNumber(std::string_view& text) {
    double value = 0;
    if (text.starts_with('+')) text.remove_prefix(1);
    const auto [end, error] = std::from_chars(text.data(), text.data() + text.size(), value, std::chars_format::fixed);
    if (error != std::errc()) return std::nullopt;
    text.remove_prefix(static_cast<std::size_t>(end - text.data()));
    return value;
}

// ---- Colours ----

constexpr Table<std::uint32_t, 34> ColorNames = {{
    {"black", 0x000000},     {"silver", 0xc0c0c0},     {"gray", 0x808080},     {"grey", 0x808080},
    {"white", 0xffffff},     {"maroon", 0x800000},     {"red", 0xff0000},      {"purple", 0x800080},
    {"fuchsia", 0xff00ff},   {"magenta", 0xff00ff},    {"green", 0x008000},    {"lime", 0x00ff00},
    {"olive", 0x808000},     {"yellow", 0xffff00},     {"navy", 0x000080},     {"blue", 0x0000ff},
    {"teal", 0x008080},      {"aqua", 0x00ffff},       {"cyan", 0x00ffff},     {"orange", 0xffa500},
    {"brown", 0xa52a2a},     {"pink", 0xffc0cb},       {"gold", 0xffd700},     {"crimson", 0xdc143c},
    {"indigo", 0x4b0082},    {"violet", 0xee82ee},     {"tomato", 0xff6347},   {"darkred", 0x8b0000},
    {"darkblue", 0x00008b},  {"darkgreen", 0x006400},  {"darkgray", 0xa9a9a9}, {"lightgray", 0xd3d3d3},
    {"lightblue", 0xadd8e6}, {"lightgreen", 0x90ee90},
}};

ColorAttribute colorFrom(std::uint32_t rgb) {
    const auto part = [&](unsigned shift) { return (rgb >> shift & 0xff) / 255.0; };
    return {part(16), part(8), part(0), 1};
}

std::optional<ColorAttribute> hexColor(std::string_view digits) {
    const bool isShort = digits.size() == 3 || digits.size() == 4;
    if (!isShort && digits.size() != 6 && digits.size() != 8) return std::nullopt;
    std::array<double, 4> parts = {0, 0, 0, 1};
    const std::size_t width = isShort ? 1 : 2;
    for (std::size_t i = 0; i * width < digits.size(); ++i) {
        unsigned value = 0;
        const char* const first = digits.data() + i * width;
        const auto [end, error] = std::from_chars(first, first + width, value, 16);
        if (error != std::errc() || end != first + width) return std::nullopt;
        parts.at(i) = value / (isShort ? 15.0 : 255.0);
    }
    return ColorAttribute{parts[0], parts[1], parts[2], parts[3]};
}

// "rgb(1, 2, 3)", "rgba(100% 0% 0% / 0.5)".
std::optional<ColorAttribute> rgbColor(std::string_view text) {
    std::array<double, 4> parts = {0, 0, 0, 1};
    for (std::size_t i = 0; i < parts.size(); ++i) {
        text.remove_prefix(std::min(text.find_first_not_of(" ,/"), text.size()));
        const std::optional<double> value = takeNumber(text);
        if (!value && i == 3) break;
        if (!value) return std::nullopt;
        const bool isPercent = text.starts_with('%');
        if (isPercent) text.remove_prefix(1);
        parts.at(i) = std::clamp(*value / (isPercent ? 100 : i == 3 ? 1 : 255), 0.0, 1.0);
    }
    return ColorAttribute{parts[0], parts[1], parts[2], parts[3]};
}

std::optional<ColorAttribute> colorOf(std::string_view value) {
    const std::string text = lower(withoutSpace(value));
    if (text.starts_with('#')) return hexColor(std::string_view(text).substr(1));
    if (text.starts_with("rgb")) {
        const std::size_t open = text.find('(');
        return open == std::string::npos ? std::nullopt : rgbColor(std::string_view(text).substr(open + 1));
    }
    const std::uint32_t* const named = find(ColorNames, text);
    return named ? std::optional(colorFrom(*named)) : std::nullopt;
}

// ---- Lengths ----

std::optional<double> lengthOf(std::string_view text, double unit) {
    const std::optional<double> value = takeNumber(text);
    if (!value) return std::nullopt;
    const Table<double, 9> units = {{{"pt", 1},
                                     {"px", PointsPerPixel},
                                     {"em", unit},
                                     {"rem", DefaultSize},
                                     {"%", unit / 100},
                                     {"in", 72},
                                     {"cm", 72 / 2.54},
                                     {"mm", 72 / 25.4},
                                     {"pc", 12}}};
    if (*value == 0) return 0;
    const double* const points = find(units, withoutSpace(text));
    return points ? std::optional(*value * *points) : std::nullopt;
}

double sizeOf(const Format& format) {
    return format.size > 0 ? format.size : DefaultSize;
}

void setSize(Format& format, double size) {
    if (size > 0) format.size = std::min(size, LargestSize);
}

void setFontSize(std::string_view value, Format& format) {
    constexpr Table<double, 7> Names = {{{"xx-small", 7},
                                         {"x-small", 7.5},
                                         {"small", 10},
                                         {"medium", 12},
                                         {"large", 13.5},
                                         {"x-large", 18},
                                         {"xx-large", 24}}};
    if (const double* const named = find(Names, value)) return setSize(format, *named);
    if (value == "smaller") return setSize(format, sizeOf(format) / 1.2);
    if (value == "larger") return setSize(format, sizeOf(format) * 1.2);
    if (const auto length = lengthOf(value, sizeOf(format))) setSize(format, *length);
}

void setFamily(std::string_view value, Format& format) {
    std::string_view first = withoutSpace(value.substr(0, value.find(',')));
    if (first.size() >= 2 && (first.front() == '"' || first.front() == '\'')) first = first.substr(1, first.size() - 2);
    const std::u16string family = fromUtf8(withoutSpace(first));
    if (family == u"inherit" || family == u"initial" || family.size() > LongestFamily) return;
    format.family = family;
}

void setAlignment(std::string_view value, Format& format) {
    constexpr Table<TextAlignment, 6> Names = {{{"left", TextAlignment::Left},
                                                {"right", TextAlignment::Right},
                                                {"center", TextAlignment::Center},
                                                {"justify", TextAlignment::Justified},
                                                {"start", TextAlignment::Natural},
                                                {"end", TextAlignment::Right}}};
    if (const TextAlignment* const named = find(Names, value)) format.paragraph.alignment = *named;
}

void setWeight(std::string_view value, Format& format) {
    constexpr double Semibold = 600;
    std::string_view rest = value;
    const std::optional<double> weight = takeNumber(rest);
    if (weight || value == "normal" || value == "lighter") format.bold = weight.value_or(0) >= Semibold;
    if (value.starts_with("bold")) format.bold = true;
}

void setDecoration(std::string_view value, Format& format) {
    const auto has = [&](std::string_view name) { return value.find(name) != std::string_view::npos; };
    if (has("none")) format.underlined = format.struckThrough = false;
    if (has("underline")) format.underlined = true;
    if (has("line-through")) format.struckThrough = true;
}

// Of a paragraph: both of its indents, or how its first line differs.
void setMargin(std::string_view value, Format& format) {
    const auto length = lengthOf(value, sizeOf(format));
    if (!length) return;
    const double change = std::clamp(*length, 0.0, LargestSize) - format.paragraph.headIndent;
    format.paragraph.headIndent += change;
    format.paragraph.firstLineHeadIndent += change;
}

void setTextIndent(std::string_view value, Format& format) {
    const auto length = lengthOf(value, sizeOf(format));
    if (length) format.paragraph.firstLineHeadIndent = format.paragraph.headIndent + std::min(*length, LargestSize);
}

void setColor(std::string_view value, Format& format) {
    if (const auto color = colorOf(value)) format.color = color;
}

void setBackground(std::string_view value, Format& format) {
    if (const auto color = colorOf(value)) format.background = color;
}

using Setter = void (*)(std::string_view value, Format& format);

// The values are in lower case, but for the names of families.
constexpr Table<Setter, 14> Properties = {{
    {"color", setColor},
    {"background-color", setBackground},
    {"background", setBackground},
    {"font-size", setFontSize},
    {"font-weight", setWeight},
    {"font-style", [](std::string_view value, Format& f) { f.italic = value == "italic" || value == "oblique"; }},
    {"text-decoration", setDecoration},
    {"text-decoration-line", setDecoration},
    {"text-align", setAlignment},
    {"margin-left", setMargin},
    {"text-indent", setTextIndent},
    {"vertical-align",
     [](std::string_view value, Format& f) { f.superscript = value == "super" ? 1
                                                             : value == "sub" ? -1
                                                                              : 0; }},
    {"white-space", [](std::string_view value, Format& f) { f.preformatted = value.starts_with("pre"); }},
    {"display", [](std::string_view value, Format& f) { f.hidden = f.hidden || value == "none"; }},
}};

// ---- Elements ----

using Change = void (*)(Format& format);

void makeBold(Format& f) {
    f.bold = true;
}
void makeItalic(Format& f) {
    f.italic = true;
}
void underline(Format& f) {
    f.underlined = true;
}
void strikeThrough(Format& f) {
    f.struckThrough = true;
}
void useFixedWidth(Format& f) {
    f.family = u"monospace";
}
template <int percent>
void makeHeading(Format& f) {
    f.bold = true;
    f.size = DefaultSize * percent / 100;
}
void hide(Format& f) {
    f.hidden = true;
}

constexpr Table<Change, 45> Elements = {{
    {"b", makeBold},
    {"strong", makeBold},
    {"th", makeBold},
    {"dt", makeBold},
    {"i", makeItalic},
    {"em", makeItalic},
    {"cite", makeItalic},
    {"dfn", makeItalic},
    {"var", makeItalic},
    {"address", makeItalic},
    {"u", underline},
    {"ins", underline},
    {"s", strikeThrough},
    {"strike", strikeThrough},
    {"del", strikeThrough},
    {"sup", [](Format& f) { f.superscript = 1; }},
    {"sub", [](Format& f) { f.superscript = -1; }},
    {"code", useFixedWidth},
    {"tt", useFixedWidth},
    {"kbd", useFixedWidth},
    {"samp", useFixedWidth},
    {"pre",
     [](Format& f) {
         f.preformatted = true;
         f.family = u"monospace";
     }},
    {"mark", [](Format& f) { f.background = colorFrom(0xffff00); }},
    {"small", [](Format& f) { f.size = sizeOf(f) * 5 / 6; }},
    {"big", [](Format& f) { setSize(f, sizeOf(f) * 6 / 5); }},
    {"center", [](Format& f) { f.paragraph.alignment = TextAlignment::Center; }},
    {"blockquote",
     [](Format& f) {
         const double indent = std::min(f.paragraph.headIndent + QuoteIndent, LargestSize);
         f.paragraph.headIndent = f.paragraph.firstLineHeadIndent = indent;
     }},
    {"dd", [](Format& f) { f.paragraph.headIndent = f.paragraph.firstLineHeadIndent = QuoteIndent; }},
    {"h1", makeHeading<200>},
    {"h2", makeHeading<150>},
    {"h3", makeHeading<117>},
    {"h4", makeHeading<100>},
    {"h5", makeHeading<83>},
    {"h6", makeHeading<67>},
    {"script", hide},
    {"style", hide},
    {"head", hide},
    {"title", hide},
    {"template", hide},
    {"iframe", hide},
    {"object", hide},
    {"svg", hide},
    {"select", hide},
    {"textarea", hide},
    {"noframes", hide},
}};

void setFontNumber(std::string_view value, Format& format) {
    constexpr std::array<double, 8> Sizes = {0, 7.5, 10, 12, 13.5, 18, 24, 36};
    const bool isChange = value.starts_with('+') || value.starts_with('-');
    const std::optional<double> number = takeNumber(value);
    if (!number) return;
    setSize(format, Sizes.at(static_cast<std::size_t>(std::clamp(*number + (isChange ? 3 : 0), 1.0, 7.0))));
}

}  // namespace

SharedAttributes attributesOf(const HTMLFormat& format) {
    auto look = std::make_shared<TextAttributes>();
    if (!format.family.empty() || format.size > 0 || format.bold || format.italic) {
        look->font = FontAttribute{format.family, format.size, format.bold, format.italic};
    }
    look->foregroundColor = format.color;
    look->backgroundColor = format.background;
    look->underlineStyle = format.underlined ? 1 : 0;
    look->strikethroughStyle = format.struckThrough ? 1 : 0;
    look->superscript = format.superscript;
    if (!format.link.empty()) look->link = format.link;
    if (format.paragraph != ParagraphStyle{}) look->paragraphStyle = format.paragraph;
    return look;
}

void applyElement(std::string_view tag, HTMLFormat& format) {
    if (const Change* const change = find(Elements, tag)) (*change)(format);
}

void applyStyle(std::string_view css, HTMLFormat& format) {
    while (!css.empty()) {
        const std::size_t end = std::min(css.find(';'), css.size());
        const std::string_view declaration = css.substr(0, end);
        css.remove_prefix(std::min(end + 1, css.size()));
        const std::size_t colon = declaration.find(':');
        if (colon == std::string_view::npos) continue;
        const std::string name = lower(withoutSpace(declaration.substr(0, colon)));
        const std::string_view value = withoutSpace(declaration.substr(colon + 1));
        if (name == "font-family") setFamily(value, format);
        if (const Setter* const set = find(Properties, name)) {
            const std::string text = lower(value);
            (*set)(withoutSpace(std::string_view(text).substr(0, text.find("!important"))), format);
        }
    }
}

void applyAttribute(std::string_view tag, std::string_view name, std::string_view value, HTMLFormat& format) {
    if (name == "align" && tag != "img" && tag != "table") setAlignment(lower(value), format);
    if (name == "bgcolor") setBackground(value, format);
    if (tag != "font") return;
    if (name == "color") setColor(value, format);
    if (name == "face") setFamily(value, format);
    if (name == "size") setFontNumber(withoutSpace(value), format);
}

}  // namespace plume
