// The tables at the head of an RTF document: fonts, colours, lists, as they fill up while one is read or written.
//
// Every table has a limit; what goes beyond it is left out. Internal to the RTF reader and writer; one of these, one
// thread.
#pragma once

#include <array>
#include <cstddef>
#include <map>
#include <optional>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

#include "Foundation/text/RTFOutput.h"
#include "Foundation/text/TextAttributes.h"

namespace plume {

// ---- Read ----

struct RTFFont {
    std::u16string family;
    bool bold = false;  // said by the font's name
    bool italic = false;
    int codePage = 0;  // 0: the document's
};

class RTFFontTable {
  public:
    // What follows describes the font of this number.
    void select(int number);
    void setCodePage(int codePage);
    // Names end with a semicolon.
    void addText(std::u16string_view text);
    // Ends a name that no semicolon ended.
    void finishName();

    // Null when the document has no such font.
    const RTFFont* find(int number) const;

  private:
    std::unordered_map<int, RTFFont> fonts_;
    RTFFont* current_ = nullptr;
    std::u16string name_;
};

// The colour table, and the extended one that may stand beside it with finer components and transparency.
class RTFColorTable {
  public:
    enum class Space { Rgb, Gray };

    void setRed(int value) { component(0, value); }
    void setGreen(int value) { component(1, value); }
    void setBlue(int value) { component(2, value); }
    void beginExpanded(Space space);
    // The next component of an expanded colour, of 100000.
    void addExpanded(int value);
    // Entries end with a semicolon; the other characters say nothing.
    void addText(std::u16string_view text, bool expanded);

    // Nothing for an automatic colour and for one that is not in the table.
    std::optional<ColorAttribute> find(int index) const;

  private:
    using Entries = std::vector<std::optional<ColorAttribute>>;
    void component(std::size_t index, int value);
    void finishExpanded();

    Entries colors_;
    Entries expanded_;
    std::optional<ColorAttribute> current_;
    std::optional<Space> space_;
    std::vector<double> components_;
};

class RTFListTable {
  public:
    // The definitions.
    void beginList();
    void beginLevel();
    void setNumberFormat(int format);
    void setStart(int start);
    void setMarker(std::u16string marker);
    void setIdentifier(int identifier);
    // The numbers under which paragraphs know them.
    void selectOverride(int identifier) { override_ = identifier; }
    void addOverride(int number);

    // The levels from the outermost to the given one; empty when there is no such list.
    std::vector<TextList> listsAt(int number, int level) const;

  private:
    TextList* currentLevel();

    std::vector<std::vector<TextList>> lists_;
    std::unordered_map<int, std::size_t> byIdentifier_;
    std::unordered_map<int, std::size_t> byNumber_;
    int override_ = 0;
};

// ---- Written ----

class RTFTableWriter {
  public:
    // The number of the font in the table; -1 for a name that RTF cannot hold.
    int fontNumber(const std::u16string& family);
    // The index of the colour in the table; 0, the automatic colour, when the table is full.
    int colorIndex(const ColorAttribute& color);
    // The number of the list whose levels these are; 0 when there are none or the table is full.
    int listNumber(const std::vector<TextList>& levels);

    void write(RTFOutput& output) const;

  private:
    using Components = std::array<double, 4>;
    struct LevelsBefore {
        bool operator()(const std::vector<TextList>& a, const std::vector<TextList>& b) const;
    };

    void writeFonts(RTFOutput& output) const;
    void writeColors(RTFOutput& output) const;
    void writeExpandedColors(RTFOutput& output) const;
    void writeLists(RTFOutput& output) const;

    std::map<std::u16string, int> fontNumbers_;
    std::map<Components, int> colorIndices_;
    std::vector<Components> colors_;
    std::map<std::vector<TextList>, int, LevelsBefore> listNumbers_;
};

}  // namespace plume
