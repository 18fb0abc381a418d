// The RTF reader's machine: groups, destinations, and the text that comes out. RTFControlWords.cpp knows the control
// words.
//
// Internal to the core. One reader reads one document once, on one thread.
#pragma once

#include <cstddef>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "Foundation/text/AttributedString.h"
#include "Foundation/text/RTFAttributes.h"
#include "Foundation/text/RTFCodePages.h"
#include "Foundation/text/RTFDocument.h"
#include "Foundation/text/RTFFormats.h"
#include "Foundation/text/RTFTables.h"

namespace plume {

// Where the text of a group goes.
enum class RTFDestination {
    Body,
    Skip,
    FontTable,
    ColorTable,
    ExpandedColorTable,
    ListTable,
    ListOverrideTable,
    ListMarker,
    FieldInstruction,
    AttachmentName
};

// The number after a control word, if there was one.
struct RTFParameter {
    std::optional<int> number;

    int valueOr(int fallback) const { return number.value_or(fallback); }
    // A face without a number is switched on, with 0 off.
    bool isOn() const { return number != 0; }
};

class RTFReader {
  public:
    struct Group {
        RTFCharacterFormat character;
        RTFParagraphFormat paragraph;
        RTFDestination destination = RTFDestination::Body;
        int fallbackCount = 1;  // characters that stand after \u for readers that do not know it
        bool isField = false;
    };

    // Both outlive the reader.
    RTFReader(std::string_view bytes, const RTFFiles& files);

    AttributedString read();

    // ---- For control words ----
    Group& group() { return groups_.back(); }
    RTFFontTable& fonts() { return fonts_; }
    RTFColorTable& colors() { return colors_; }
    RTFListTable& lists() { return lists_; }
    void setDestination(RTFDestination destination);
    void setCodePage(int codePage);
    void setDefaultFont(int font);
    // What follows in this group is a list item's marker; it will stand between two tabs whatever its writer does.
    void expectListMarker() { markerGroup_ = groups_.size(); }
    // Character formatting as at the start of the document; a link goes on.
    void resetCharacterFormat();

  private:
    struct Run {
        std::size_t length;
        RTFCharacterFormat format;
    };
    void openGroup();
    void closeGroup();
    void finishDestination(const Group& closed);
    void readControl();
    void readSymbol(char symbol);
    void readWord();
    void performWord(std::string_view word, RTFParameter parameter);
    std::optional<int> readNumber();
    void readHexadecimalByte();
    void readLiteralText();
    void skipBinary(RTFParameter parameter);
    void readCodeUnit(RTFParameter parameter);

    bool takesText() const;
    bool isFallback();
    void addByte(char byte);
    void flushBytes();
    void emit(std::u16string_view text);
    void addToBody(std::u16string_view text);
    void addRun(std::u16string_view text, const RTFCharacterFormat& format);
    void endParagraph();

    void addAttachment(std::u16string_view name);

    std::string_view bytes_;
    std::size_t position_ = 0;
    bool ended_ = false;

    std::vector<Group> groups_;
    std::size_t groupsTooDeep_ = 0;
    std::size_t markerGroup_ = 0;  // how many groups are open where a list item's marker is to come; 0: nowhere
    bool isIgnorable_ = false;     // "\*" stood just before
    int fallbackRemaining_ = 0;    // characters still to be left out after \u

    RTFCodePages codePages_;
    RTFFontTable fonts_;
    RTFColorTable colors_;
    RTFListTable lists_;
    int codePage_ = RTFLatinCodePage;
    std::optional<int> defaultFont_;
    RTFAttributes attributes_;

    std::string pendingBytes_;  // bytes that wait for their neighbours: a character may take two
    std::u16string units_;      // scratch
    std::u16string captured_;   // text of a destination that is read as a whole
    std::u16string paragraph_;  // the text of the paragraph so far
    std::vector<Run> runs_;     // and its formats
    AttributedString result_;
};

// Characters that control words stand for, as "emdash"; 0 when the word is not one of them.
char16_t rtfCharacterOfWord(std::string_view word);

// Changes the reader's state as the control word says; false when the word is not known.
bool performRTFControl(RTFReader& reader, std::string_view word, RTFParameter parameter);

}  // namespace plume
