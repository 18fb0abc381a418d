// Changes of how the text in a document looks: its attributes, its paragraphs, and lists.
//
// Each change is one edit of the document, and touches only what the change is about: chips and files stay what they
// are. Main thread.
#pragma once

#include <functional>
#include <optional>
#include <string>

#include "Foundation/text/TextAttributes.h"

class QTextCharFormat;
class QTextCursor;

namespace plume {

using AttributesChange = std::function<void(TextAttributes& attributes)>;
using StyleChange = std::function<void(ParagraphStyle& style)>;

// What is typed behind a character of this format has these: all but the file that the character stands for.
SharedAttributes typingAttributes(const QTextCharFormat& format);

// Of the selection.
void changeAttributes(const QTextCursor& cursor, const AttributesChange& change);
// Of the paragraphs that the selection touches, or that the cursor stands in.
void changeStyle(const QTextCursor& cursor, const StyleChange& change);
ParagraphStyle styleAt(const QTextCursor& cursor);

// ---- Lists ----
// An item is a paragraph that begins with its marker between two tabs.
namespace ListMarker {
inline constexpr const char16_t* Bullets = u"{disc}";
inline constexpr const char16_t* Numbers = u"{decimal}.";
}  // namespace ListMarker

// Makes the paragraphs of the selection items of such a list, or, when all are, ordinary paragraphs.
void toggleList(const QTextCursor& cursor, const std::u16string& markerFormat);
// A new item behind the one in which the cursor stands; an empty item becomes an ordinary paragraph. False, and
// nothing is done, outside of lists.
bool continueList(QTextCursor& cursor);
// Makes the item whose text begins at the cursor an ordinary paragraph. False when there is none.
bool endListAtItemStart(const QTextCursor& cursor);

}  // namespace plume
