#include "app/editor/ChipWords.h"

#include <QLocale>
#include <QStringList>
#include <cstdint>
#include <string_view>

#include "app/qt/Text.h"
#include "content/PlaceholderKinds.h"
#include "content/SnippetAbbreviationVariable.h"
#include "content/SnippetClipboardVariable.h"
#include "content/SnippetDateTimeVariable.h"
#include "content/SnippetFieldVariable.h"
#include "content/SnippetKeyVariable.h"

namespace plume {

namespace {

// On one line, and no longer than a chip can bear.
QString inChip(std::u16string_view text) {
    constexpr qsizetype Longest = 60;
    QString line = toQString(text.substr(0, 2 * Longest));
    for (QChar& character : line) {
        if (!character.isPrint() && !character.isSurrogate()) character = QChar::Space;
    }
    if (line.size() <= Longest) return line;
    line.truncate(Longest - 1);
    if (line.back().isHighSurrogate()) line.chop(1);
    return line + QChar(0x2026);
}

QString inChip(const SnippetVariable::Text& text) {
    return inChip(std::u16string_view(text ? *text : std::u16string()));
}

QString titled(const QString& title, const QString& words) {
    return words.isEmpty() ? title : QStringLiteral("%1: %2").arg(title, words);
}

// Steps away from a moment, in words: "today + 1 week − 2 hours".
class StepWords {
  public:
    explicit StepWords(QString start) : words_(std::move(start)) {}

    void add(std::int64_t count, const char* one, const char* many) {
        if (count == 0) return;
        const QString sign = count < 0 ? QStringLiteral(" \u2212 ") : QStringLiteral(" + ");
        // The least number has no counterpart.
        const std::uint64_t size =
            count < 0 ? ~static_cast<std::uint64_t>(count) + 1 : static_cast<std::uint64_t>(count);
        words_ += sign + (size == 1 ? ChipWords::tr(one) : ChipWords::tr(many).arg(size));
    }
    const QString& words() const { return words_; }

  private:
    QString words_;
};

constexpr int DaysPerWeek = 7;

QString stepsOf(const SnippetDateVariable& date) {
    StepWords steps(ChipWords::tr("today"));
    steps.add(date.year, QT_TRANSLATE_NOOP("ChipWords", "1 year"), QT_TRANSLATE_NOOP("ChipWords", "%1 years"));
    steps.add(date.month, QT_TRANSLATE_NOOP("ChipWords", "1 month"), QT_TRANSLATE_NOOP("ChipWords", "%1 months"));
    if (date.day % DaysPerWeek == 0) {
        steps.add(date.day / DaysPerWeek, QT_TRANSLATE_NOOP("ChipWords", "1 week"),
                  QT_TRANSLATE_NOOP("ChipWords", "%1 weeks"));
    } else {
        steps.add(date.day, QT_TRANSLATE_NOOP("ChipWords", "1 day"), QT_TRANSLATE_NOOP("ChipWords", "%1 days"));
    }
    return steps.words();
}

QString stepsOf(const SnippetTimeVariable& time) {
    StepWords steps(ChipWords::tr("now"));
    steps.add(time.hour, QT_TRANSLATE_NOOP("ChipWords", "1 hour"), QT_TRANSLATE_NOOP("ChipWords", "%1 hours"));
    steps.add(time.minute, QT_TRANSLATE_NOOP("ChipWords", "1 minute"), QT_TRANSLATE_NOOP("ChipWords", "%1 minutes"));
    steps.add(time.second, QT_TRANSLATE_NOOP("ChipWords", "1 second"), QT_TRANSLATE_NOOP("ChipWords", "%1 seconds"));
    return steps.words();
}

// Sunday is 0; other numbers than a week's name no day.
QString weekdayName(std::int64_t weekday) {
    if (weekday < 0 || weekday >= DaysPerWeek) return QString::number(weekday);
    return QLocale().dayName(weekday == 0 ? DaysPerWeek : static_cast<int>(weekday));
}

}  // namespace

QString chipWords(const std::u16string& body, const ContentEnvironment& environment) {
    std::shared_ptr<SnippetVariable> variable = parseVariable(body);
    if (!variable) variable = parseSign(body, 0);
    // A body that begins with a sign and goes on is a chip, but nothing comes of it.
    if (!variable) return startsWithKeyword(body) ? inChip(std::u16string_view(body)) : QString();
    return ChipWords(environment).of(*variable);
}

QString ChipWords::of(const SnippetVariable& variable) const {
    QString words = ofKind(variable);
    if (!variable.isOptional) return words;
    return variable.isSelected ? tr("%1 (optional, ticked)").arg(words) : tr("%1 (optional)").arg(words);
}

QString ChipWords::ofKind(const SnippetVariable& variable) const {
    if (const auto* date = dynamic_cast<const SnippetDateVariable*>(&variable)) return ofDate(*date);
    if (const auto* time = dynamic_cast<const SnippetTimeVariable*>(&variable)) return ofTime(*time);
    if (const auto* clipboard = dynamic_cast<const SnippetClipboardVariable*>(&variable))
        return ofClipboard(*clipboard);
    if (const auto* field = dynamic_cast<const SnippetFieldVariable*>(&variable)) return ofField(*field);
    if (const auto* key = dynamic_cast<const SnippetKeyVariable*>(&variable)) return ofKey(*key);
    if (const auto* nested = dynamic_cast<const SnippetAbbreviationVariable*>(&variable)) {
        return titled(tr("Snippet"), inChip(nested->abbreviation));
    }
    return tr("Caret");
}

QString ChipWords::ofDate(const SnippetDateVariable& date) const {
    using ValueType = SnippetDateVariable::ValueType;
    const QString value = inChip(std::u16string_view(date.value(environment_)));
    QString moment = stepsOf(date);
    if (date.valueType == ValueType::NextWeekday) {
        moment = tr("next %1").arg(weekdayName(date.weekday));
    } else if (date.valueType != ValueType::Offset) {
        moment = tr("previous %1").arg(weekdayName(date.weekday));
    }
    return titled(tr("Date"), value.isEmpty() ? moment : QStringLiteral("%1, %2").arg(moment, value));
}

QString ChipWords::ofTime(const SnippetTimeVariable& time) const {
    const QString value = inChip(std::u16string_view(time.value(environment_)));
    const bool isNow = time.hour == 0 && time.minute == 0 && time.second == 0;
    if (isNow && !value.isEmpty()) return titled(tr("Time"), value);
    const QString moment = stepsOf(time);
    return titled(tr("Time"), value.isEmpty() ? moment : QStringLiteral("%1, %2").arg(moment, value));
}

QString ChipWords::ofClipboard(const SnippetClipboardVariable& clipboard) {
    const QString find = inChip(clipboard.find);
    if (find.isEmpty()) return tr("Clipboard");
    const QString replacement = inChip(clipboard.replacement);
    return titled(tr("Clipboard"), replacement.isEmpty() ? tr("without %1").arg(find)
                                                         : QStringLiteral("%1 \u2192 %2").arg(find, replacement));
}

QString ChipWords::ofField(const SnippetFieldVariable& field) {
    const QString kind = field.isMultiline()   ? tr("Text area")
                         : field.isPopupMenu() ? tr("Menu")
                         : field.isNumber()    ? tr("Number")
                                               : tr("Field");
    return titled(kind, inChip(field.name));
}

QString ChipWords::ofKey(const SnippetKeyVariable& key) {
    QStringList keys;
    if (key.control()) keys.append(tr("Ctrl"));
    if (key.option()) keys.append(tr("Alt"));
    if (key.shift()) keys.append(tr("Shift"));
    if (key.command()) keys.append(tr("Super"));
    const QString label = inChip(key.key);
    if (!label.isEmpty()) keys.append(label);
    // An arrow by itself needs no other word.
    QString words = key.isArrow() && keys.size() == 1 ? label : titled(tr("Key"), keys.join(u'+'));
    if (key.count > 1) words += QStringLiteral(" \u00D7 %1").arg(key.count);
    if (key.delay > 0)
        words += tr(", after %1 s").arg(QLocale().toString(key.delay, 'g', QLocale::FloatingPointShortest));
    return words;
}

}  // namespace plume
