// The text of a document unit for unit.
#pragma once

#include <QString>
#include <QTextDocument>

namespace plume {

// Qt's own plain text has spaces in place of those that do not break.
inline QString rawText(const QTextDocument& document) {
    return document.toRawText().replace(QChar::ParagraphSeparator, QLatin1Char('\n'));
}

}  // namespace plume
