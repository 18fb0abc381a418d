#include "app/editor/DateTimeForm.h"

#include <QComboBox>
#include <QFormLayout>
#include <QLineEdit>
#include <QMenu>
#include <QSignalBlocker>
#include <QSpinBox>
#include <QToolButton>
#include <array>
#include <utility>

#include "app/editor/LocaleChoice.h"
#include "app/qt/Text.h"
#include "app/qt/WheelGuard.h"

namespace plume {

namespace {

constexpr std::array Styles{u"short", u"medium", u"long", u"full"};
constexpr int FurthestOffset = 1'000'000;

struct PatternLetters {
    const char16_t* letters;
    const char* meaning;
};
constexpr PatternLetters DayLetters[] = {
    {u"yyyy", QT_TRANSLATE_NOOP("plume::DateTimeForm", "Year")},
    {u"yy", QT_TRANSLATE_NOOP("plume::DateTimeForm", "Year, two digits")},
    {u"M", QT_TRANSLATE_NOOP("plume::DateTimeForm", "Month")},
    {u"MM", QT_TRANSLATE_NOOP("plume::DateTimeForm", "Month, two digits")},
    {u"MMM", QT_TRANSLATE_NOOP("plume::DateTimeForm", "Month, abbreviated")},
    {u"MMMM", QT_TRANSLATE_NOOP("plume::DateTimeForm", "Month, name")},
    {u"d", QT_TRANSLATE_NOOP("plume::DateTimeForm", "Day")},
    {u"dd", QT_TRANSLATE_NOOP("plume::DateTimeForm", "Day, two digits")},
    {u"EEE", QT_TRANSLATE_NOOP("plume::DateTimeForm", "Weekday, abbreviated")},
    {u"EEEE", QT_TRANSLATE_NOOP("plume::DateTimeForm", "Weekday, name")},
    {u"w", QT_TRANSLATE_NOOP("plume::DateTimeForm", "Week of the year")},
    {u"D", QT_TRANSLATE_NOOP("plume::DateTimeForm", "Day of the year")},
    {u"QQQ", QT_TRANSLATE_NOOP("plume::DateTimeForm", "Quarter")},
};
constexpr PatternLetters HourLetters[] = {
    {u"HH", QT_TRANSLATE_NOOP("plume::DateTimeForm", "Hour, 00 to 23")},
    {u"h", QT_TRANSLATE_NOOP("plume::DateTimeForm", "Hour, 1 to 12")},
    {u"mm", QT_TRANSLATE_NOOP("plume::DateTimeForm", "Minute")},
    {u"ss", QT_TRANSLATE_NOOP("plume::DateTimeForm", "Second")},
    {u"a", QT_TRANSLATE_NOOP("plume::DateTimeForm", "Half of the day")},
    {u"zzz", QT_TRANSLATE_NOOP("plume::DateTimeForm", "Time zone")},
};

}  // namespace

DateTimeForm::DateTimeForm(const QString& title, ChipFormServices services,
                           std::shared_ptr<SnippetDateTimeVariable> variable, DateTextKind kind)
    : ChipForm(title, std::move(services), variable), variable_(std::move(variable)), kind_(kind) {}

ChipForm::Shown DateTimeForm::shown() const {
    const auto text = formattedDate(variable_->date(services().environment), kind_, variable_->format.value_or(u""),
                                    variable_->locale, services().environment);
    if (!text) {
        return {{},
                tr("The pattern has letters without a meaning, so nothing is written. Put text between apostrophes.")};
    }
    return {tr("Gives: %1").arg(toQString(*text)), text->empty() ? tr("The pattern is empty.") : QString()};
}

QString DateTimeForm::inFormat(const std::u16string& format) const {
    const auto& environment = services().environment;
    return toQString(formattedDate(environment.now(), kind_, format, variable_->locale, environment).value_or(u""));
}

void DateTimeForm::addFormatRows() {
    style_ = new QComboBox;
    style_->setSizeAdjustPolicy(QComboBox::AdjustToMinimumContentsLengthWithIcon);
    style_->setMinimumContentsLength(16);
    ignoreWheelWithoutFocus(*style_);
    fillStyles();
    pattern_ = makeLine(variable_->format, [this](std::u16string text) {
        variable_->format = std::move(text);
        changed();
    });
    patternRow_ = makeRow({pattern_, makePatternHelp()});
    rows().addRow(tr("&Style:"), style_);
    rows().addRow(tr("&Pattern:"), patternRow_);
    pattern_->setAccessibleName(tr("Pattern"));
    rows().setRowVisible(patternRow_, style_->currentData().toString().isEmpty());
    connect(style_, &QComboBox::currentIndexChanged, this, &DateTimeForm::styleChosen);
}

void DateTimeForm::fillStyles() {
    const std::array names{tr("Short: %1"), tr("Medium: %1"), tr("Long: %1"), tr("Full: %1")};
    const QSignalBlocker silent(style_);
    const int row = style_->currentIndex();
    const bool isFirst = style_->count() == 0;
    style_->clear();
    for (std::size_t i = 0; i < Styles.size(); ++i) {
        style_->addItem(names.at(i).arg(inFormat(Styles.at(i))), QString::fromUtf16(Styles.at(i)));
    }
    style_->addItem(tr("Own pattern"), QString());
    const int named = style_->findData(toQString(variable_->format.value_or(u"")));
    const int last = style_->count() - 1;
    style_->setCurrentIndex(!isFirst ? row : named < 0 ? last : named);
}

void DateTimeForm::styleChosen() {
    const QString style = style_->currentData().toString();
    const QString start = kind_ == DateTextKind::DayOnly ? QStringLiteral("yyyy-MM-dd") : QStringLiteral("HH:mm");
    variable_->format = fromQString(style.isEmpty() ? start : style);
    {
        const QSignalBlocker silent(pattern_);
        pattern_->setText(style.isEmpty() ? start : QString());
    }
    rows().setRowVisible(patternRow_, style.isEmpty());
    fitToRows();
    changed();
}

QToolButton* DateTimeForm::makePatternHelp() {
    auto* help = new QToolButton;
    help->setText(tr("Letters"));
    help->setAccessibleName(tr("Letters of patterns"));
    help->setToolTip(tr("What letters of a pattern stand for; choosing one puts it in"));
    help->setPopupMode(QToolButton::InstantPopup);
    help->setFocusPolicy(Qt::StrongFocus);
    auto* menu = new QMenu(help);
    const auto add = [&](const PatternLetters& each) {
        const QString letters = QString::fromUtf16(each.letters);
        const QString example = inFormat(each.letters);
        QAction* action = menu->addAction(tr("%1 (%2): %3").arg(tr(each.meaning), letters, example));
        connect(action, &QAction::triggered, pattern_, [this, letters] {
            pattern_->insert(letters);
            pattern_->setFocus();
        });
    };
    for (const PatternLetters& each : DayLetters) add(each);
    menu->addSeparator();
    for (const PatternLetters& each : HourLetters) add(each);
    help->setMenu(menu);
    return help;
}

void DateTimeForm::addLocaleRow() {
    auto* locale = new LocaleChoice(variable_->locale);
    connect(locale, &LocaleChoice::edited, this, [this](const std::optional<std::u16string>& name) {
        variable_->locale = name;
        fillStyles();
        changed();
    });
    rows().addRow(tr("La&nguage:"), locale);
}

QWidget* DateTimeForm::makeOffset(std::int64_t& offset, const QString& unit, const QString& name) {
    QSpinBox* number = makeNumber(offset, -FurthestOffset, FurthestOffset, [this, &offset](std::int64_t value) {
        offset = value;
        changed();
    });
    number->setPrefix(unit + QLatin1Char(' '));
    number->setAccessibleName(name);
    return number;
}

}  // namespace plume
