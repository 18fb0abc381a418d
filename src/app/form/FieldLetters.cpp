#include "app/form/FieldLetters.h"

#include <QChar>
#include <QSet>

namespace plume {

namespace {

// Of scripts whose letters are keys of a keyboard.
bool isOnKeyboard(QChar letter) {
    switch (letter.script()) {
        case QChar::Script_Han:
        case QChar::Script_Hangul:
        case QChar::Script_Hiragana:
        case QChar::Script_Katakana:
            return false;
        default:
            return letter.isLetter();
    }
}

QString doubled(QString text) {
    return text.replace(QLatin1Char('&'), QStringLiteral("&&"));
}

qsizetype freeLetter(const QString& name, const QSet<QChar>& taken) {
    for (qsizetype index = 0; index < name.size(); ++index) {
        if (isOnKeyboard(name[index]) && !taken.contains(name[index].toUpper())) return index;
    }
    return -1;
}

QChar freeDigit(const QSet<QChar>& taken) {
    for (char16_t digit = u'1'; digit <= u'9'; ++digit) {
        if (!taken.contains(QChar(digit))) return QChar(digit);
    }
    return {};
}

}  // namespace

std::vector<QString> withLetters(const std::vector<QString>& names) {
    QSet<QChar> taken;
    std::vector<QString> result;
    for (const QString& name : names) {
        const qsizetype index = freeLetter(name, taken);
        QString text = doubled(name);
        if (index >= 0) {
            taken.insert(name[index].toUpper());
            text = doubled(name.left(index)) + QLatin1Char('&') + doubled(name.mid(index));
        } else if (const QChar digit = freeDigit(taken); !digit.isNull()) {
            taken.insert(digit);
            text += QStringLiteral(" (&") + digit + QLatin1Char(')');
        }
        result.push_back(std::move(text));
    }
    return result;
}

}  // namespace plume
