#include "Foundation/text/HTMLTextBuilder.h"

#include <utility>

namespace plume {

namespace {

constexpr char16_t LineSeparator = 0x2028;
constexpr char16_t NoBreakSpace = 0xa0;
constexpr char16_t ObjectReplacementCharacter = 0xfffc;

bool isSpace(char16_t unit) {
    return unit == u' ' || unit == u'\t' || unit == u'\n' || unit == u'\r' || unit == u'\f';
}

}  // namespace

// ---- Text ----

void HTMLTextBuilder::addText(std::u16string_view text, const SharedAttributes& look, bool preformatted) {
    for (const char16_t unit : text) {
        if (preformatted) {
            addPreformatted(unit, look);
        } else {
            addSpaceOrUnit(unit, look);
        }
    }
}

void HTMLTextBuilder::addSpaceOrUnit(char16_t unit, const SharedAttributes& look) {
    if (!isSpace(unit)) return addUnit(unit, look);
    if (hasSpace_) return;
    hasSpace_ = true;
    spaceLook_ = look;
}

void HTMLTextBuilder::addUnit(char16_t unit, const SharedAttributes& look) {
    flushBreak();
    flushSpace();
    // Writers put no-break spaces where plain ones would be folded.
    if (unit == NoBreakSpace && (atLineStart_ || last_ == u' ')) unit = u' ';
    put(unit, look);
    line_ = Line::Text;
    atLineStart_ = false;
}

void HTMLTextBuilder::addPreformatted(char16_t unit, const SharedAttributes& look) {
    const bool isFirst = std::exchange(startsPreformatted_, false);
    if (unit == u'\r') return;
    if (unit != u'\n') return addUnit(unit, look);
    if (isFirst) return;
    flushBreak();
    // The last line feed of a block ends its last line, which the block's end does too.
    if (line_ == Line::Text) {
        break_ = Break::Soft;
    } else {
        addLineBreak(look);
    }
}

void HTMLTextBuilder::addAttachment(std::shared_ptr<const TextAttachment> attachment, const SharedAttributes& look) {
    auto own = look ? std::make_shared<TextAttributes>(*look) : std::make_shared<TextAttributes>();
    own->attachment = std::move(attachment);
    addUnit(ObjectReplacementCharacter, own);
}

// ---- Lines ----

void HTMLTextBuilder::addLineBreak(const SharedAttributes& look) {
    flushBreak();
    hasSpace_ = false;
    put(inItem_ ? LineSeparator : u'\n', look);
    line_ = inItem_ ? Line::Marker : Line::Empty;
    atLineStart_ = true;
}

void HTMLTextBuilder::endBlock() {
    hasSpace_ = false;
    if (line_ == Line::Text && break_ == Break::None) break_ = Break::Soft;
}

void HTMLTextBuilder::endItem() {
    hasSpace_ = false;
    if (line_ != Line::Empty) break_ = Break::Hard;
    inItem_ = false;
}

void HTMLTextBuilder::startItem(std::u16string_view marker, const SharedAttributes& look) {
    endItem();
    flushBreak();
    for (const char16_t unit : marker) put(unit, look);
    line_ = Line::Marker;
    inItem_ = true;
    atLineStart_ = true;
}

void HTMLTextBuilder::startCell(const SharedAttributes& look) {
    if (line_ == Line::Text && break_ == Break::None) put(u'\t', look);
    hasSpace_ = false;
    atLineStart_ = true;
}

void HTMLTextBuilder::flushBreak() {
    if (break_ == Break::None) return;
    const bool staysInItem = inItem_ && break_ == Break::Soft;
    put(staysInItem ? LineSeparator : u'\n', runLook_);
    line_ = staysInItem ? Line::Marker : Line::Empty;
    break_ = Break::None;
    atLineStart_ = true;
}

void HTMLTextBuilder::flushSpace() {
    if (std::exchange(hasSpace_, false) && !atLineStart_) put(u' ', spaceLook_);
}

// ---- Runs ----

void HTMLTextBuilder::put(char16_t unit, const SharedAttributes& look) {
    if (runLook_ != look) {
        flushRun();
        runLook_ = look;
    }
    run_ += unit;
    last_ = unit;
}

void HTMLTextBuilder::flushRun() {
    text_.append(run_, runLook_);
    run_.clear();
}

AttributedString HTMLTextBuilder::take() {
    if (last_ == NoBreakSpace) run_.back() = u' ';
    flushRun();
    return std::exchange(text_, AttributedString());
}

}  // namespace plume
