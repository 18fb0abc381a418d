// Puts the text of HTML elements together: folds white space, ends lines where blocks begin and end, marks items.
#pragma once

#include <memory>
#include <string>
#include <string_view>

#include "Foundation/text/AttributedString.h"

namespace plume {

class HTMLTextBuilder {
  public:
    // Folds white space, unless `preformatted`.
    void addText(std::u16string_view text, const SharedAttributes& look, bool preformatted);
    // One character that stands for a file.
    void addAttachment(std::shared_ptr<const TextAttachment> attachment, const SharedAttributes& look);
    void addLineBreak(const SharedAttributes& look);
    // What follows stands in a line of its own.
    void endBlock();
    // As endBlock(), also behind an item that has only its marker.
    void endItem();
    void startItem(std::u16string_view marker, const SharedAttributes& look);
    // The next line feed of preformatted text does not count.
    void startPreformatted() { startsPreformatted_ = true; }
    // The next cell of a table's row.
    void startCell(const SharedAttributes& look);

    AttributedString take();

  private:
    enum class Line { Empty, Marker, Text };
    enum class Break { None, Soft, Hard };

    void addUnit(char16_t unit, const SharedAttributes& look);
    void addSpaceOrUnit(char16_t unit, const SharedAttributes& look);
    void addPreformatted(char16_t unit, const SharedAttributes& look);
    void put(char16_t unit, const SharedAttributes& look);
    void flushBreak();
    void flushSpace();
    void flushRun();

    AttributedString text_;
    std::u16string run_;  // not yet in text_
    SharedAttributes runLook_;
    SharedAttributes spaceLook_;
    Line line_ = Line::Empty;
    Break break_ = Break::None;
    bool inItem_ = false;
    bool atLineStart_ = true;
    bool hasSpace_ = false;  // white space came, which counts when more text follows in the line
    bool startsPreformatted_ = false;
    char16_t last_ = 0;
};

}  // namespace plume
