#include "app/search/SnippetRow.h"

#include <QCoreApplication>
#include <QStringList>
#include <array>

#include "app/qt/Text.h"

namespace plume {

QString SnippetRow::spoken() const {
    QStringList parts;
    for (const QString& part : {abbreviation.text, label.text, content.text, group, shortcut}) {
        if (!part.isEmpty()) parts.append(part);
    }
    return parts.join(QStringLiteral(", "));
}

QString inOneLine(std::u16string_view text) {
    QString line = toQString(text);
    for (QChar& unit : line) {
        const bool breaks = unit < QChar(0x20) || unit == QChar::LineSeparator || unit == QChar::ParagraphSeparator;
        if (breaks || unit == QChar(0x7F) || unit == QChar(0x85)) unit = QChar::Space;
    }
    return line;
}

QString digitShortcut(char16_t digit, std::int64_t selectorKeyModifier) {
    // As the settings call them, which Qt does only where its own translations are installed.
    const std::array forms{QStringLiteral("%1"), QCoreApplication::translate("SnippetRow", "Shift+%1"),
                           QCoreApplication::translate("SnippetRow", "Ctrl+%1"),
                           QCoreApplication::translate("SnippetRow", "Alt+%1"),
                           QCoreApplication::translate("SnippetRow", "Super+%1")};
    if (digit == u'\0' || selectorKeyModifier < 0 || selectorKeyModifier >= std::ssize(forms)) return {};
    return forms.at(static_cast<std::size_t>(selectorKeyModifier)).arg(QChar(digit));
}

}  // namespace plume
