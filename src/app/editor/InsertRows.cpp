// The rows of the menu that inserts placeholders: a new ready variant is a line here.
#include <unicode/dtptngen.h>

#include <QCoreApplication>
#include <memory>
#include <utility>

#include "Foundation/UserLocale.h"
#include "app/editor/InsertModel.h"
#include "app/qt/Text.h"
#include "content/SnippetAbbreviationVariable.h"
#include "content/SnippetClipboardVariable.h"
#include "content/SnippetDateTimeVariable.h"
#include "content/SnippetFieldVariable.h"
#include "content/SnippetKeyVariable.h"

namespace plume {

namespace {

QString told(const char* text) {
    return QCoreApplication::translate("InsertMenu", text);
}

// Day and time as the locale writes them, in one pattern.
std::u16string dayAndTimePattern(const ContentEnvironment& environment) {
    const std::string name = environment.locale.empty() ? userLocale(LocaleCategory::Dates) : environment.locale;
    UErrorCode status = U_ZERO_ERROR;
    const std::unique_ptr<icu::DateTimePatternGenerator> generator(
        icu::DateTimePatternGenerator::createInstance(icu::Locale(name.c_str()), status));
    if (U_FAILURE(status)) return u"yyyy-MM-dd HH:mm";
    const icu::UnicodeString pattern = generator->getBestPattern(icu::UnicodeString(u"yMMMdjm"), status);
    if (U_FAILURE(status) || pattern.isEmpty()) return u"yyyy-MM-dd HH:mm";
    return {pattern.getBuffer(), static_cast<std::size_t>(pattern.length())};
}

class RowMaker {
  public:
    explicit RowMaker(const ChipFormServices& services) : environment_(services.environment) {
        environment_.report = nullptr;
    }

    const ContentEnvironment& environment() const { return environment_; }
    void kind(const QString& name) { kind_ = name; }
    void add(const QString& title, const QString& words, const std::u16string& body, bool asks = false) {
        rows.push_back({title, words, {}, kind_, body, asks, nullptr});
    }
    // With what it gives now, unless it asks first.
    void add(const QString& title, const QString& words, const SnippetDateTimeVariable& moment, bool asks = false) {
        add(title, words, moment.toString(), asks);
        if (!asks) rows.back().sample = toQString(moment.value(environment_));
    }

    std::vector<InsertRow> rows;

  private:
    ContentEnvironment environment_;
    QString kind_;
};

SnippetDateVariable today(const std::u16string& format) {
    SnippetDateVariable date;
    date.format = format;
    return date;
}

SnippetDateVariable inDays(std::int64_t days) {
    SnippetDateVariable date = today(u"medium");
    date.day = days;
    return date;
}

SnippetDateVariable nextWeekday(std::int64_t weekday) {
    SnippetDateVariable date = today(u"full");
    date.valueType = SnippetDateVariable::ValueType::NextWeekday;
    date.weekday = weekday;
    return date;
}

SnippetTimeVariable now(const std::u16string& format) {
    SnippetTimeVariable time;
    time.format = format;
    return time;
}

void addDates(RowMaker& rows) {
    constexpr std::int64_t Monday = 1;
    constexpr std::int64_t Week = 7;
    const QString words = told("day today now");
    rows.kind(told("Date"));
    rows.add(told("Date, short"), words, today(u"short"));
    rows.add(told("Date, medium"), words, today(u"medium"));
    rows.add(told("Date, long"), words, today(u"long"));
    rows.add(told("Date, full"), words, today(u"full"));
    rows.add(told("Date, for sorting"), words + QStringLiteral(" ISO"), today(u"yyyy-MM-dd"));
    rows.add(told("Date and time"), words, today(dayAndTimePattern(rows.environment())));
    rows.add(told("Tomorrow"), {}, inDays(1));
    rows.add(told("Yesterday"), {}, inDays(-1));
    rows.add(told("In a week"), {}, inDays(Week));
    rows.add(told("Next Monday"), told("weekday"), nextWeekday(Monday));
    rows.add(told("Weekday"), words, today(u"EEEE"));
    rows.add(told("Month"), words, today(u"MMMM"));
    rows.add(told("Year"), words, today(u"yyyy"));
    rows.add(told("Week number"), words, today(u"w"));
    rows.add(told("Other date…"), told("offset pattern weekday language"), today(u"medium"), true);
}

void addTimes(RowMaker& rows) {
    const QString words = told("clock hour now");
    SnippetTimeVariable inAnHour = now(u"short");
    inAnHour.hour = 1;
    rows.kind(told("Time"));
    rows.add(told("Time, short"), words, now(u"short"));
    rows.add(told("Time with seconds"), words, now(u"medium"));
    rows.add(told("In an hour"), words, inAnHour);
    rows.add(told("Other time…"), told("offset pattern language"), now(u"short"), true);
}

void addFields(RowMaker& rows) {
    const auto add = [&](const QString& title, const QString& words, FieldType type) {
        SnippetFieldVariable field;
        field.name = fromQString(told("Name"));
        field.type = type;
        rows.add(title, words, field.toString(), true);
    };
    rows.kind(told("Field of the form"));
    add(told("Field: one line…"), told("form fill in ask text"), FieldType::Singleline);
    add(told("Field: several lines…"), told("form fill in ask text area"), FieldType::Multiline);
    add(told("Field: menu…"), told("form fill in ask choice pop-up"), FieldType::PopupMenu);
    add(told("Field: number…"), told("form fill in ask calculate"), FieldType::Number);
}

void addKeys(RowMaker& rows) {
    const QString words = told("press key");
    const auto add = [&](const QString& title, const char16_t* label, KeyCode code, bool asks = false) {
        rows.add(title, words, SnippetKeyVariable(label, code).toString(), asks);
        if (!asks) rows.rows.back().sample = QString::fromUtf16(label);
    };
    rows.kind(told("Key"));
    add(told("Return"), u"↩", KeyCode::Return);
    add(told("Tab"), u"⇥", KeyCode::Tab);
    add(told("Escape"), u"⎋", KeyCode::Escape);
    add(told("Left"), u"◀", KeyCode::Left);
    add(told("Right"), u"▶", KeyCode::Right);
    add(told("Up"), u"▲", KeyCode::Up);
    add(told("Down"), u"▼", KeyCode::Down);
    add(told("Other key…"), u"↩", KeyCode::Return, true);
}

void addOthers(RowMaker& rows) {
    SnippetClipboardVariable replacing;
    rows.kind(told("Clipboard"));
    rows.add(told("Clipboard"), told("paste"), u"clipboard");
    rows.add(told("Clipboard with changes…"), told("paste find replace"), replacing.toString(), true);
    rows.kind(told("Caret"));
    rows.add(told("Caret"), told("cursor place"), SnippetContentCaret().toString());
}

}  // namespace

std::vector<InsertRow> snippetRows(const ChipFormServices& services) {
    std::vector<InsertRow> rows;
    if (!services.groups) return rows;
    for (const auto& group : services.groups()) {
        for (const auto& snippet : group->items()) {
            if (snippet == services.inside) continue;
            SnippetAbbreviationVariable variable;
            variable.abbreviation = snippet->abbreviation().value_or(u"");
            if (snippet->uuid()) variable.uuid = snippet->uuid()->toString();
            rows.push_back({{}, {}, {}, {}, variable.toString(), false, snippet});
        }
    }
    return rows;
}

std::vector<InsertRow> insertRows(const ChipFormServices& services) {
    RowMaker maker(services);
    addDates(maker);
    addTimes(maker);
    addOthers(maker);
    addFields(maker);
    addKeys(maker);
    std::vector<InsertRow> snippets = snippetRows(services);
    if (!snippets.empty()) {
        maker.kind(told("Snippet"));
        maker.add(told("Snippet with options…"), told("optional"), SnippetAbbreviationVariable().toString(), true);
    }
    std::vector<InsertRow> rows = std::move(maker.rows);
    rows.insert(rows.end(), snippets.begin(), snippets.end());
    return rows;
}

}  // namespace plume
