// Attributed texts in Qt's documents: every unit of the text is one character of the document, and comes back with the
// attributes that it came with, whether or not Qt can show them.
//
// Paragraphs end at line feeds, carriage returns, both together, and U+2029; how each is written is kept. Attachments
// are objects (TextFormats.h): those with a cell text chips, all others files. Main thread.
#pragma once

#include <cstddef>

#include "Foundation/text/AttributedString.h"

class QTextCursor;
class QTextDocument;

namespace plume {

// Shows the content and nothing else. Chips are for what convertToSnippetEditContent() has made them of.
void setDocument(QTextDocument& document, const AttributedString& content);
// What the document holds, chips as their placeholders between markers.
AttributedString contentOf(const QTextDocument& document);

// What stands between two positions of the document.
AttributedString contentBetween(const QTextDocument& document, int from, int to);
// Likewise, chips as attachments with their body as cell text.
AttributedString editContentBetween(const QTextDocument& document, int from, int to);

// Inserts the content's units from `from` to `to`. Paragraphs that begin there take their style from the content, and
// so does the one behind; the cursor's own paragraph does when it is the content's, too.
void insertContent(QTextCursor& cursor, const AttributedString& content, std::size_t from, std::size_t to);
// Inserts a text from elsewhere: what stands before and behind the cursor keeps its paragraph's style.
void insertForeignContent(QTextCursor& cursor, const AttributedString& content);

// The positions that so many units from the content's start take up in a document.
int positionsFor(const AttributedString& content, std::size_t units);

}  // namespace plume
