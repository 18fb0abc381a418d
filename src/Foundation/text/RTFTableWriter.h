// The tables at the head of an RTF document, as they fill up while its text is written: fonts, colours, lists.
//
// Internal to the RTF writer; one writer, one thread.
#pragma once

#include <array>
#include <map>
#include <string>
#include <vector>

#include "Foundation/text/RTFOutput.h"
#include "Foundation/text/TextAttributes.h"

namespace plume {

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
