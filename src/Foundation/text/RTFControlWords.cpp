#include <algorithm>
#include <unordered_map>

#include "Foundation/text/RTFReader.h"

namespace plume {

namespace {

constexpr int MaximumFallbackCount = 1000;
constexpr int DefaultBaselineShift = 6;  // half points

using Perform = void (*)(RTFReader&, RTFParameter);
using Controls = std::unordered_map<std::string_view, Perform>;

template <RTFDestination destination>
void startDestination(RTFReader& reader, RTFParameter) {
    reader.setDestination(destination);
}

template <int RTFCharacterFormat::*member, int value>
void setCharacter(RTFReader& reader, RTFParameter parameter) {
    reader.group().character.*member = parameter.isOn() ? value : 0;
}

template <bool RTFCharacterFormat::*member>
void setFace(RTFReader& reader, RTFParameter parameter) {
    RTFCharacterFormat& character = reader.group().character;
    character.*member = parameter.isOn();
    if (parameter.isOn()) character.hasFont = true;
}

template <int RTFCharacterFormat::*member>
void setColor(RTFReader& reader, RTFParameter parameter) {
    reader.group().character.*member = parameter.valueOr(0);
}

template <TextAlignment alignment>
void setAlignment(RTFReader& reader, RTFParameter) {
    reader.group().paragraph.alignment = alignment;
}

template <int RTFParagraphFormat::*member>
void setDistance(RTFReader& reader, RTFParameter parameter) {
    reader.group().paragraph.*member = std::clamp(parameter.valueOr(0), -RTFMaximumTwips, RTFMaximumTwips);
}

template <int codePage>
void useCodePage(RTFReader& reader, RTFParameter) {
    reader.setCodePage(codePage);
}

void useFont(RTFReader& reader, RTFParameter parameter) {
    if (reader.group().destination == RTFDestination::FontTable) {
        reader.fonts().select(parameter.valueOr(0));
    }
    reader.group().character.hasFont = true;
    reader.group().character.font = parameter.valueOr(0);
}

void useFontSize(RTFReader& reader, RTFParameter parameter) {
    RTFCharacterFormat& character = reader.group().character;
    character.hasFont = true;
    const int halfPoints = parameter.valueOr(RTFDefaultHalfPoints);
    character.halfPoints = halfPoints <= 0 ? RTFDefaultHalfPoints : std::min(halfPoints, RTFMaximumHalfPoints);
}

template <int sign>
void shiftBaseline(RTFReader& reader, RTFParameter parameter) {
    const int shift = std::clamp(parameter.valueOr(DefaultBaselineShift), -RTFMaximumHalfPoints, RTFMaximumHalfPoints);
    reader.group().character.raisedHalfPoints = sign * shift;
}

void addTabStop(RTFReader& reader, RTFParameter parameter) {
    auto& tabStops = reader.group().paragraph.tabStops;
    if (tabStops && tabStops->size() >= RTFMaximumTabStops) return;
    auto extended = tabStops ? std::make_shared<std::vector<int>>(*tabStops) : std::make_shared<std::vector<int>>();
    extended->push_back(std::clamp(parameter.valueOr(0), -RTFMaximumTwips, RTFMaximumTwips));
    tabStops = std::move(extended);
}

void setListIdentifier(RTFReader& reader, RTFParameter parameter) {
    const RTFDestination destination = reader.group().destination;
    if (destination == RTFDestination::ListTable) reader.lists().setIdentifier(parameter.valueOr(0));
    if (destination == RTFDestination::ListOverrideTable) reader.lists().selectOverride(parameter.valueOr(0));
}

void setListNumber(RTFReader& reader, RTFParameter parameter) {
    if (reader.group().destination == RTFDestination::ListOverrideTable) {
        reader.lists().addOverride(parameter.valueOr(0));
    } else {
        reader.group().paragraph.list = parameter.valueOr(0);
    }
}

const Controls& characterControls() {
    using Format = RTFCharacterFormat;
    static const Controls controls = {
        {"plain", [](RTFReader& reader, RTFParameter) { reader.resetCharacterFormat(); }},
        {"f", useFont},
        {"fs", useFontSize},
        {"b", setFace<&Format::bold>},
        {"i", setFace<&Format::italic>},
        {"v", [](RTFReader& reader, RTFParameter p) { reader.group().character.hidden = p.isOn(); }},
        {"ul", setCharacter<&Format::underline, 1>},
        {"ulth", setCharacter<&Format::underline, 2>},
        {"uldb", setCharacter<&Format::underline, 9>},
        {"uld", setCharacter<&Format::underline, 1>},
        {"uldash", setCharacter<&Format::underline, 1>},
        {"ulw", setCharacter<&Format::underline, 1>},
        {"ulwave", setCharacter<&Format::underline, 1>},
        {"ulnone", setCharacter<&Format::underline, 0>},
        {"strike", setCharacter<&Format::strikethrough, 1>},
        {"striked", setCharacter<&Format::strikethrough, 9>},
        {"super", setCharacter<&Format::superscript, 1>},
        {"sub", setCharacter<&Format::superscript, -1>},
        {"nosupersub", setCharacter<&Format::superscript, 0>},
        {"up", shiftBaseline<1>},
        {"dn", shiftBaseline<-1>},
        {"cf", setColor<&Format::foreground>},
        {"cb", setColor<&Format::background>},
        {"chcbpat", setColor<&Format::background>},
        {"highlight", setColor<&Format::background>},
    };
    return controls;
}

const Controls& paragraphControls() {
    using Format = RTFParagraphFormat;
    static const Controls controls = {
        {"pard", [](RTFReader& reader, RTFParameter) { reader.group().paragraph = {}; }},
        {"ql", setAlignment<TextAlignment::Left>},
        {"qr", setAlignment<TextAlignment::Right>},
        {"qc", setAlignment<TextAlignment::Center>},
        {"qj", setAlignment<TextAlignment::Justified>},
        {"li", setDistance<&Format::leftIndent>},
        {"fi", setDistance<&Format::firstLineIndent>},
        {"ri", setDistance<&Format::rightIndent>},
        {"sb", setDistance<&Format::spaceBefore>},
        {"sa", setDistance<&Format::spaceAfter>},
        {"sl", setDistance<&Format::lineHeight>},
        {"slleading", setDistance<&Format::leading>},
        {"slmult", [](RTFReader& reader, RTFParameter p) { reader.group().paragraph.isLineMultiple = p.number == 1; }},
        {"tx", addTabStop},
        {"ls", setListNumber},
        {"ilvl",
         [](RTFReader& reader, RTFParameter p) {
             reader.group().paragraph.listLevel = std::clamp(p.valueOr(0), 0, RTFDeepestListLevel);
         }},
    };
    return controls;
}

const Controls& tableControls() {
    using Space = RTFColorTable::Space;
    static const Controls controls = {
        {"fcharset",
         [](RTFReader& reader, RTFParameter p) {
             const int codePage = RTFCodePages::codePageOfCharacterSet(p.valueOr(0));
             if (codePage != 0) reader.fonts().setCodePage(codePage);
         }},
        {"cpg",
         [](RTFReader& reader, RTFParameter p) {
             if (RTFCodePages::isKnown(p.valueOr(0))) reader.fonts().setCodePage(p.valueOr(0));
         }},
        {"red", [](RTFReader& reader, RTFParameter p) { reader.colors().setRed(p.valueOr(0)); }},
        {"green", [](RTFReader& reader, RTFParameter p) { reader.colors().setGreen(p.valueOr(0)); }},
        {"blue", [](RTFReader& reader, RTFParameter p) { reader.colors().setBlue(p.valueOr(0)); }},
        {"cssrgb", [](RTFReader& reader, RTFParameter) { reader.colors().beginExpanded(Space::Rgb); }},
        {"csgenericrgb", [](RTFReader& reader, RTFParameter) { reader.colors().beginExpanded(Space::Rgb); }},
        {"csgray", [](RTFReader& reader, RTFParameter) { reader.colors().beginExpanded(Space::Gray); }},
        {"c", [](RTFReader& reader, RTFParameter p) { reader.colors().addExpanded(p.valueOr(0)); }},
        {"list", [](RTFReader& reader, RTFParameter) { reader.lists().beginList(); }},
        {"listlevel", [](RTFReader& reader, RTFParameter) { reader.lists().beginLevel(); }},
        {"levelnfc", [](RTFReader& reader, RTFParameter p) { reader.lists().setNumberFormat(p.valueOr(0)); }},
        {"levelstartat", [](RTFReader& reader, RTFParameter p) { reader.lists().setStart(p.valueOr(1)); }},
        {"listid", setListIdentifier},
    };
    return controls;
}

const Controls& documentControls() {
    using Destination = RTFDestination;
    static const Controls controls = {
        {"ansi", useCodePage<RTFLatinCodePage>},
        {"mac", useCodePage<10000>},
        {"pc", useCodePage<437>},
        {"pca", useCodePage<850>},
        {"ansicpg", [](RTFReader& reader, RTFParameter p) { reader.setCodePage(p.valueOr(RTFLatinCodePage)); }},
        {"deff", [](RTFReader& reader, RTFParameter p) { reader.setDefaultFont(p.valueOr(0)); }},
        {"uc",
         [](RTFReader& reader, RTFParameter p) {
             reader.group().fallbackCount = std::clamp(p.valueOr(1), 0, MaximumFallbackCount);
         }},
        {"field", [](RTFReader& reader, RTFParameter) { reader.group().isField = true; }},
        {"fldinst", startDestination<Destination::FieldInstruction>},
        {"NeXTGraphic", startDestination<Destination::AttachmentName>},
        {"fonttbl", startDestination<Destination::FontTable>},
        {"colortbl", startDestination<Destination::ColorTable>},
        {"expandedcolortbl", startDestination<Destination::ExpandedColorTable>},
        {"listtable", startDestination<Destination::ListTable>},
        {"listoverridetable", startDestination<Destination::ListOverrideTable>},
        {"listtext", [](RTFReader& reader, RTFParameter) { reader.expectListMarker(); }},
        {"levelmarker", startDestination<Destination::ListMarker>},
        {"stylesheet", startDestination<Destination::Skip>},
        {"info", startDestination<Destination::Skip>},
        {"pict", startDestination<Destination::Skip>},
        {"nonshppict", startDestination<Destination::Skip>},
        {"header", startDestination<Destination::Skip>},
        {"headerl", startDestination<Destination::Skip>},
        {"headerr", startDestination<Destination::Skip>},
        {"headerf", startDestination<Destination::Skip>},
        {"footer", startDestination<Destination::Skip>},
        {"footerl", startDestination<Destination::Skip>},
        {"footerr", startDestination<Destination::Skip>},
        {"footerf", startDestination<Destination::Skip>},
        {"footnote", startDestination<Destination::Skip>},
        {"filetbl", startDestination<Destination::Skip>},
        {"revtbl", startDestination<Destination::Skip>},
        {"xe", startDestination<Destination::Skip>},
        {"tc", startDestination<Destination::Skip>},
        {"private", startDestination<Destination::Skip>},
    };
    return controls;
}

}  // namespace

char16_t rtfCharacterOfWord(std::string_view word) {
    static const std::unordered_map<std::string_view, char16_t> characters = {
        {"par", u'\n'},         {"sect", u'\n'},        {"row", u'\n'},           {"nestrow", u'\n'},
        {"tab", u'\t'},         {"cell", u'\t'},        {"nestcell", u'\t'},      {"line", u'\u2028'},
        {"page", u'\f'},        {"emdash", u'\u2014'},  {"endash", u'\u2013'},    {"bullet", u'\u2022'},
        {"lquote", u'\u2018'},  {"rquote", u'\u2019'},  {"ldblquote", u'\u201C'}, {"rdblquote", u'\u201D'},
        {"emspace", u'\u2003'}, {"enspace", u'\u2002'}, {"qmspace", u'\u2005'},   {"zwj", u'\u200D'},
        {"zwnj", u'\u200C'},    {"zwbo", u'\u200B'},    {"zwnbo", u'\u2060'},     {"ltrmark", u'\u200E'},
        {"rtlmark", u'\u200F'},
    };
    const auto found = characters.find(word);
    return found == characters.end() ? u'\0' : found->second;
}

bool performRTFControl(RTFReader& reader, std::string_view word, RTFParameter parameter) {
    for (const Controls* controls :
         {&characterControls(), &paragraphControls(), &documentControls(), &tableControls()}) {
        const auto control = controls->find(word);
        if (control == controls->end()) continue;
        control->second(reader, parameter);
        return true;
    }
    return false;
}

}  // namespace plume
