// Between the attributes of texts and the formats of Qt's documents.
//
// A format holds the attributes that it was made from, and shows of them what Qt can show. The attributes are what
// counts: to change how a text looks is to give it the format of other attributes. Main thread.
#pragma once

#include <QTextFormat>
#include <memory>
#include <optional>

#include "Foundation/text/TextAttributes.h"

namespace plume {

// What stands in a document as one U+FFFC and is drawn by a handler of its own.
namespace InlineObject {
inline constexpr int Chip = QTextFormat::UserObject + 1;
inline constexpr int File = QTextFormat::UserObject + 2;  // a picture, or any other file
}  // namespace InlineObject

// What formats hold besides what Qt shows.
namespace TextProperty {
inline constexpr int Attributes = QTextFormat::UserProperty + 1;     // of characters: SharedAttributes
inline constexpr int AttributesKey = QTextFormat::UserProperty + 2;  // tells formats apart by a number, which is fast
inline constexpr int Identity = QTextFormat::UserProperty + 3;   // of objects: no two have the same, so none is merged
inline constexpr int Body = QTextFormat::UserProperty + 4;       // of chips: of their placeholder
inline constexpr int LineBreak = QTextFormat::UserProperty + 5;  // of breaks between paragraphs: how it is written
inline constexpr int OwnStyle = QTextFormat::UserProperty + 6;   // of characters: not in the style of their paragraph
inline constexpr int Style = QTextFormat::UserProperty + 7;      // of paragraphs: SharedStyle
inline constexpr int StyleEdited = QTextFormat::UserProperty + 8;  // of paragraphs: OwnStyle counts no longer
}  // namespace TextProperty

// Null: nothing is said.
using SharedStyle = std::shared_ptr<const ParagraphStyle>;

QTextCharFormat charFormatOf(const SharedAttributes& attributes);
// Null when the format was made from none.
SharedAttributes attributesIn(const QTextFormat& format);
SharedAttributes withStyle(const SharedAttributes& attributes, const std::optional<ParagraphStyle>& style);
std::optional<ParagraphStyle> styleIn(const SharedAttributes& attributes);

QTextBlockFormat blockFormatOf(const std::optional<ParagraphStyle>& style);
SharedStyle styleOf(const QTextBlockFormat& format);

// The attributes carry the placeholder's attachment no longer.
QTextCharFormat chipFormatOf(const std::u16string& body, const SharedAttributes& attributes);
QTextCharFormat fileFormatOf(const SharedAttributes& attributes);
bool isChip(const QTextFormat& format);
std::u16string bodyOf(const QTextFormat& chip);

}  // namespace plume
