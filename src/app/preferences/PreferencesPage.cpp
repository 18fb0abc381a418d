#include "app/preferences/PreferencesPage.h"

#include <QCheckBox>
#include <QComboBox>
#include <QDoubleSpinBox>
#include <QFormLayout>
#include <QHBoxLayout>
#include <QLabel>
#include <QSignalBlocker>
#include <QSpinBox>
#include <QStyle>
#include <QVBoxLayout>
#include <algorithm>
#include <utility>

#include "app/preferences/ApplicationList.h"
#include "app/preferences/SettingControls.h"
#include "app/qt/Labels.h"
#include "app/qt/Sentences.h"
#include "app/qt/Text.h"
#include "app/qt/WheelGuard.h"
#include "library/PLFunctionAvailability.h"

namespace plume {

namespace {

constexpr int WidestLine = 104;  // characters
constexpr int AboveHeading = 12;
constexpr int HelpSpacing = 2;
constexpr int SecondsDecimals = 2;
constexpr double SecondsStep = 0.1;

// Numbers are kept when they are finished, not with every digit.
template <typename SpinBox, typename Number>
SpinBox* spinBox(Number least, Number most) {
    auto* box = new SpinBox;
    box->setRange(least, most);
    box->setKeyboardTracking(false);
    box->setAlignment(Qt::AlignRight);
    ignoreWheelWithoutFocus(*box);
    return box;
}

}  // namespace

PreferencesPage::PreferencesPage(Around around) : around_(std::move(around)), form_(new QFormLayout(this)) {
    setMaximumWidth(fontMetrics().averageCharWidth() * WidestLine);
    form_->setContentsMargins(20, 16, 20, 16);
    form_->setVerticalSpacing(10);
    form_->setHorizontalSpacing(12);
    form_->setLabelAlignment(Qt::AlignLeft | Qt::AlignTop);
    form_->setFormAlignment(Qt::AlignLeft | Qt::AlignTop);
    form_->setFieldGrowthPolicy(QFormLayout::AllNonFixedFieldsGrow);
}

void PreferencesPage::finish() {
    for (auto* lines : findChildren<LinesEdit*>()) lines->finish();
}

void PreferencesPage::restoreDefaults() {
    for (const std::string& key : ownKeys_) {
        if (!giveUp(key)) return;
    }
}

void PreferencesPage::follow(const Keys& keys) {
    for (const std::string& key : keys) showAgain(key);
}

void PreferencesPage::showAgain(std::string_view key) {
    for (const auto& [bound, show] : shows_) {
        if (bound == key) show();
    }
}

bool PreferencesPage::write(std::string_view key, PropertyList value) {
    const auto written = settings().setObject(key, std::move(value));
    complain(written ? QString() : tr("This could not be kept. %1").arg(inUsersLanguage(written.error().message)));
    if (!written) showAgain(key);
    return written.ok();
}

bool PreferencesPage::giveUp(std::string_view key) {
    const auto removed = settings().removeObject(key);
    complain(removed ? QString() : tr("This could not be kept. %1").arg(inUsersLanguage(removed.error().message)));
    if (!removed) showAgain(key);
    return removed.ok();
}

void PreferencesPage::bind(const char* key, std::function<void()> show) {
    show();
    shows_.emplace_back(key, std::move(show));
    if (std::find(ownKeys_.begin(), ownKeys_.end(), key) == ownKeys_.end()) ownKeys_.emplace_back(key);
}

// ---- Rows ----

void PreferencesPage::addHeading(const QString& text) {
    QLabel* heading = makeSectionTitle(text);
    if (form_->rowCount() > 0) heading->setContentsMargins(0, AboveHeading, 0, 0);
    form_->addRow(heading);
}

QLabel* PreferencesPage::addNote(const QString& text) {
    QLabel* note = makeTextLabel(text);
    form_->addRow(note);
    return note;
}

QWidget* PreferencesPage::withHelp(QWidget* field, const QString& help, int indent) {
    auto* both = new QWidget;
    auto* layout = new QVBoxLayout(both);
    layout->setContentsMargins(0, 0, 0, 0);
    layout->setSpacing(HelpSpacing);
    const bool grows = field->sizePolicy().horizontalPolicy() & QSizePolicy::ExpandFlag;
    layout->addWidget(field, 0, grows ? Qt::Alignment() : Qt::AlignLeft);
    if (help.isEmpty()) return both;
    QLabel* words = makeHelpLabel(help);
    auto* indented = new QHBoxLayout;
    indented->addSpacing(indent);
    indented->addWidget(words, 1);
    layout->addLayout(indented);
    field->setAccessibleDescription(help);
    return both;
}

void PreferencesPage::remember(const QString& label, QWidget* field, const QString& help, const QStringList& keys) {
    QString words = label;
    words.remove(u'&');
    if (field->accessibleName().isEmpty()) field->setAccessibleName(words);
    rows_.push_back({words, help, keys, field});
}

void PreferencesPage::addField(const QString& label, QWidget* field, const QString& help, const QStringList& keys) {
    auto* name = new QLabel(label);
    name->setBuddy(field);
    form_->addRow(name, withHelp(field, help, 0));
    // Level with the field's first line, however high the row is.
    const QWidget* control = field->focusProxy() ? field->focusProxy() : field;
    name->setMinimumWidth(name->sizeHint().width());
    name->setFixedHeight(std::min(control->sizeHint().height(), fontMetrics().height() * 2));
    remember(label, field, help, keys);
}

void PreferencesPage::addWide(const QString& label, QWidget* field, const QString& help, const QStringList& keys) {
    const int indent =
        style()->pixelMetric(QStyle::PM_IndicatorWidth) + style()->pixelMetric(QStyle::PM_CheckBoxLabelSpacing);
    form_->addRow(withHelp(field, help, qobject_cast<QCheckBox*>(field) ? indent : 0));
    remember(label, field, help, keys);
}

void PreferencesPage::addFilling(const QString& label, QWidget* field, const QStringList& keys) {
    setMaximumWidth(QWIDGETSIZE_MAX);
    QSizePolicy policy(QSizePolicy::Expanding, QSizePolicy::Expanding);
    policy.setVerticalStretch(1);
    field->setSizePolicy(policy);
    form_->addRow(field);
    remember(label, field, {}, keys);
}

// ---- Controls ----

QCheckBox* PreferencesPage::addCheckBox(const char* key, const QString& label, const QString& help) {
    auto* box = new QCheckBox(label);
    addWide(label, box, help, {QLatin1String(key)});
    bind(key, [this, key, box] {
        const QSignalBlocker quiet(box);
        box->setChecked(settings().boolForKey(key));
    });
    connect(box, &QCheckBox::toggled, this, [this, key](bool on) { write(key, on); });
    return box;
}

QCheckBox* PreferencesPage::addBit(const char* key, std::int64_t bit, const QString& label, const QString& help) {
    auto* box = new QCheckBox(label);
    addWide(label, box, help, {QLatin1String(key)});
    bind(key, [this, key, bit, box] {
        const QSignalBlocker quiet(box);
        box->setChecked((settings().integerForKey(key) & bit) != 0);
    });
    connect(box, &QCheckBox::toggled, this, [this, key, bit](bool on) {
        const std::int64_t value = settings().integerForKey(key);
        write(key, on ? value | bit : value & ~bit);
    });
    return box;
}

QComboBox* PreferencesPage::addChoice(const char* key, const QString& label, const Choices& choices,
                                      const QString& help) {
    auto* box = new QComboBox;
    ignoreWheelWithoutFocus(*box);
    for (const auto& [value, text] : choices) box->addItem(text, QVariant::fromValue(value));
    addField(label, box, help, {QLatin1String(key)});
    bind(key, [this, key, box] {
        const QSignalBlocker quiet(box);
        const std::int64_t value = settings().integerForKey(key);
        const int index = box->findData(QVariant::fromValue(value));
        box->setPlaceholderText(index < 0 ? tr("Another value (%1)").arg(value) : QString());
        box->setCurrentIndex(index);
    });
    connect(box, &QComboBox::currentIndexChanged, this, [this, key, box](int index) {
        if (index >= 0) write(key, box->itemData(index).value<std::int64_t>());
    });
    return box;
}

QSpinBox* PreferencesPage::addNumber(const char* key, const QString& label, const Numbers& numbers,
                                     const QString& help) {
    auto* box = spinBox<QSpinBox>(numbers.least, numbers.most);
    addField(label, box, help, {QLatin1String(key)});
    bind(key, [this, key, box, unit = numbers.unit] {
        const QSignalBlocker quiet(box);
        box->setValue(int(std::clamp<std::int64_t>(settings().integerForKey(key), box->minimum(), box->maximum())));
        box->setSuffix(unit(box->value()));
    });
    connect(box, &QSpinBox::valueChanged, this, [this, key](int value) { write(key, std::int64_t{value}); });
    return box;
}

QDoubleSpinBox* PreferencesPage::addSeconds(const char* key, const QString& label, double most, const QString& help) {
    auto* box = spinBox<QDoubleSpinBox>(0.0, most);
    box->setSuffix(tr(" seconds"));
    box->setDecimals(SecondsDecimals);
    box->setSingleStep(SecondsStep);
    addField(label, box, help, {QLatin1String(key)});
    bind(key, [this, key, box] {
        const QSignalBlocker quiet(box);
        box->setValue(settings().doubleForKey(key));
    });
    connect(box, &QDoubleSpinBox::valueChanged, this, [this, key](double value) { write(key, value); });
    return box;
}

LinesEdit* PreferencesPage::addLines(const char* key, const QString& label, const QString& help) {
    auto* lines = new LinesEdit;
    addField(label, lines, help, {QLatin1String(key)});
    bind(key, [this, key, lines] { lines->showText(settings().stringForKey(key).value_or(u"")); });
    connect(lines, &LinesEdit::edited, this, [this, key](const std::u16string& text) { write(key, text); });
    return lines;
}

ApplicationList* PreferencesPage::addAvailability(const char* optionKey, const char* listKey, const QString& label) {
    addChoice(optionKey, label,
              {{PLFunctionAvailability::Everywhere, tr("In all programs")},
               {PLFunctionAvailability::ExceptListed, tr("In all programs except those below")},
               {PLFunctionAvailability::OnlyListed, tr("Only in the programs below")}});
    auto* list = new ApplicationList(services().programs, programs());
    addWide(tr("Programs"), list, {}, {QLatin1String(listKey)});
    bind(listKey, [this, listKey, list] {
        list->setIdentifiers(settings().stringArrayForKey(listKey).value_or(ApplicationList::Identifiers()));
    });
    bind(optionKey, [this, optionKey, list] {
        const std::int64_t option = settings().integerForKey(optionKey);
        list->setTitle(option == PLFunctionAvailability::OnlyListed ? tr("Enabled") : tr("Ignored"));
        list->setEnabled(option != PLFunctionAvailability::Everywhere);
    });
    connect(list, &ApplicationList::edited, this, [this, listKey](const ApplicationList::Identifiers& identifiers) {
        write(listKey, PropertyList::Array(identifiers.begin(), identifiers.end()));
    });
    return list;
}

}  // namespace plume
