#include "app/editor/KeyForm.h"

#include <QCheckBox>
#include <QComboBox>
#include <QDoubleSpinBox>
#include <QEvent>
#include <QFormLayout>
#include <QKeyEvent>
#include <QPointer>
#include <QPushButton>
#include <QSignalBlocker>
#include <QSpinBox>
#include <algorithm>
#include <array>
#include <utility>

#include "app/editor/FormControls.h"
#include "app/qt/Text.h"
#include "app/qt/WheelGuard.h"

namespace plume {

namespace {

constexpr int PatienceForKeys = 10'000;  // milliseconds
constexpr int DelayDigits = 3;

struct NamedKey {
    KeyCode key;
    const char* name;
    const char16_t* label;  // as it is stored
};
constexpr std::array NamedKeys{
    NamedKey{KeyCode::Return, QT_TRANSLATE_NOOP("plume::KeyForm", "Return"), u"↩"},
    NamedKey{KeyCode::Tab, QT_TRANSLATE_NOOP("plume::KeyForm", "Tab"), u"⇥"},
    NamedKey{KeyCode::Escape, QT_TRANSLATE_NOOP("plume::KeyForm", "Escape"), u"⎋"},
    NamedKey{KeyCode::Space, QT_TRANSLATE_NOOP("plume::KeyForm", "Space"), u"Space"},
    NamedKey{KeyCode::Delete, QT_TRANSLATE_NOOP("plume::KeyForm", "Backspace"), u"⌫"},
    NamedKey{KeyCode::ForwardDelete, QT_TRANSLATE_NOOP("plume::KeyForm", "Delete"), u"⌦"},
    NamedKey{KeyCode::Left, QT_TRANSLATE_NOOP("plume::KeyForm", "Left"), u"◀"},
    NamedKey{KeyCode::Right, QT_TRANSLATE_NOOP("plume::KeyForm", "Right"), u"▶"},
    NamedKey{KeyCode::Up, QT_TRANSLATE_NOOP("plume::KeyForm", "Up"), u"▲"},
    NamedKey{KeyCode::Down, QT_TRANSLATE_NOOP("plume::KeyForm", "Down"), u"▼"},
    NamedKey{KeyCode::Home, QT_TRANSLATE_NOOP("plume::KeyForm", "Home"), u"↖"},
    NamedKey{KeyCode::End, QT_TRANSLATE_NOOP("plume::KeyForm", "End"), u"↘"},
    NamedKey{KeyCode::PageUp, QT_TRANSLATE_NOOP("plume::KeyForm", "Page Up"), u"⇞"},
    NamedKey{KeyCode::PageDown, QT_TRANSLATE_NOOP("plume::KeyForm", "Page Down"), u"⇟"},
    NamedKey{KeyCode::KeypadEnter, QT_TRANSLATE_NOOP("plume::KeyForm", "Enter of the keypad"), u"⌅"},
    NamedKey{KeyCode::Help, QT_TRANSLATE_NOOP("plume::KeyForm", "Insert"), u"?"},
};

// They are called by what services say of them.
constexpr std::array OtherKeys{
    KeyCode::F1,     KeyCode::F2,     KeyCode::F3,     KeyCode::F4,     KeyCode::F5,     KeyCode::F6,
    KeyCode::F7,     KeyCode::F8,     KeyCode::F9,     KeyCode::F10,    KeyCode::F11,    KeyCode::F12,
    KeyCode::A,      KeyCode::B,      KeyCode::C,      KeyCode::D,      KeyCode::E,      KeyCode::F,
    KeyCode::G,      KeyCode::H,      KeyCode::I,      KeyCode::J,      KeyCode::K,      KeyCode::L,
    KeyCode::M,      KeyCode::N,      KeyCode::O,      KeyCode::P,      KeyCode::Q,      KeyCode::R,
    KeyCode::S,      KeyCode::T,      KeyCode::U,      KeyCode::V,      KeyCode::W,      KeyCode::X,
    KeyCode::Y,      KeyCode::Z,      KeyCode::Digit0, KeyCode::Digit1, KeyCode::Digit2, KeyCode::Digit3,
    KeyCode::Digit4, KeyCode::Digit5, KeyCode::Digit6, KeyCode::Digit7, KeyCode::Digit8, KeyCode::Digit9,
};

const NamedKey* namedKey(KeyCode key) {
    const auto* found =
        std::find_if(NamedKeys.begin(), NamedKeys.end(), [key](const NamedKey& each) { return each.key == key; });
    return found == NamedKeys.end() ? nullptr : found;
}

}  // namespace

KeyForm::KeyForm(ChipFormServices services, std::shared_ptr<SnippetKeyVariable> variable)
    : ChipForm(tr("Key"), std::move(services), variable), variable_(std::move(variable)) {
    addKeyRow();
    addModifierRow();
    addTimesRows();
    patience_.setSingleShot(true);
    patience_.setInterval(PatienceForKeys);
    connect(&patience_, &QTimer::timeout, this, [this] {
        remark_ = tr("Nothing was heard. Plume may not hear the keyboard at the moment.");
        endRecording();
    });
}

KeyForm::~KeyForm() {
    if (recording_ && services().endRecordingKey) services().endRecordingKey();
}

// ---- Controls ----

void KeyForm::addKeyRow() {
    key_ = new QComboBox;
    key_->setSizeAdjustPolicy(QComboBox::AdjustToMinimumContentsLengthWithIcon);
    key_->setMinimumContentsLength(12);
    key_->setPlaceholderText(tr("No key"));
    key_->setAccessibleName(tr("Key"));
    ignoreWheelWithoutFocus(*key_);
    for (const NamedKey& each : NamedKeys) addKey(each.key);
    for (const KeyCode key : OtherKeys) {
        if (!nameOf(key).isEmpty()) addKey(key);
    }
    if (variable_->keyCode != KeyCode::None && key_->findData(numberOf(variable_->keyCode)) < 0) {
        const QString label = toQString(variable_->key.value_or(u""));
        key_->addItem(label.isEmpty() ? tr("Key %1").arg(numberOf(variable_->keyCode)) : label,
                      numberOf(variable_->keyCode));
    }
    key_->setCurrentIndex(key_->findData(numberOf(variable_->keyCode)));
    connect(key_, &QComboBox::currentIndexChanged, this,
            [this] { setKey(KeyCode{static_cast<std::uint16_t>(key_->currentData().toUInt())}); });
    record_ = new QPushButton(tr("&Record"));
    record_->setAutoDefault(false);
    record_->setVisible(static_cast<bool>(services().beginRecordingKey));
    record_->setToolTip(tr("Takes the next key that is pressed"));
    record_->installEventFilter(this);
    connect(record_, &QPushButton::clicked, this, &KeyForm::beginRecording);
    rows().addRow(tr("&Key:"), makeRow({key_, record_}));
}

void KeyForm::addKey(KeyCode key) {
    const NamedKey* named = namedKey(key);
    key_->addItem(named ? QString::fromUtf16(named->label) + QStringLiteral("  ") + tr(named->name) : nameOf(key),
                  numberOf(key));
}

void KeyForm::addModifierRow() {
    const auto add = [this](const QString& name, EventFlag flag) {
        QCheckBox* tick =
            makeTick(name, variable_->modifiers.contains(flag), [this, flag](bool isOn) { setFlag(flag, isOn); });
        modifiers_.emplace_back(flag, tick);
        return tick;
    };
    rows().addRow(tr("Held with it:"),
                  makeRow({add(tr("Ctr&l"), EventFlag::Control), add(tr("&Alt"), EventFlag::Option),
                           add(tr("&Shift"), EventFlag::Shift), add(tr("S&uper"), EventFlag::Command)}));
}

void KeyForm::addTimesRows() {
    QSpinBox* count =
        makeNumber(static_cast<std::int64_t>(variable_->count), 1,
                   static_cast<std::int64_t>(SnippetKeyVariable::MaximumCount), [this](std::int64_t times) {
                       variable_->count = static_cast<std::uint64_t>(times);
                       changed();
                   });
    auto* delay = new QDoubleSpinBox;
    delay->setDecimals(DelayDigits);
    delay->setRange(0, SnippetKeyVariable::MaximumDelay);
    constexpr double Step = 0.1;
    delay->setSingleStep(Step);
    delay->setValue(variable_->delay);
    delay->setSpecialValueText(tr("Not at all"));
    delay->setSuffix(QLatin1Char(' ') + tr("seconds"));
    ignoreWheelWithoutFocus(*delay);
    connect(delay, &QDoubleSpinBox::valueChanged, this, [this](double seconds) {
        variable_->delay = seconds;
        changed();
    });
    rows().addRow(tr("&Times pressed:"), count);
    rows().addRow(tr("&Waits before:"), delay);
}

// ---- What is set ----

QString KeyForm::nameOf(KeyCode key) const {
    if (const NamedKey* named = namedKey(key)) return tr(named->name);
    return services().keyName ? toQString(services().keyName(key)) : QString();
}

void KeyForm::setKey(KeyCode key) {
    const NamedKey* named = namedKey(key);
    variable_->keyCode = key;
    variable_->key = named ? named->label : fromQString(key_->currentText());
    changed();
}

void KeyForm::setFlag(EventFlag flag, bool isOn) {
    isOn ? variable_->modifiers |= flag : variable_->modifiers -= flag;
    changed();
}

ChipForm::Shown KeyForm::shown() const {
    if (variable_->keyCode == KeyCode::None) return {tr("Presses no key."), remark_};
    QStringList keys;
    for (const auto& [flag, tick] : modifiers_) {
        if (variable_->modifiers.contains(flag)) keys.append(tick->text().remove(QLatin1Char('&')));
    }
    const QString name = nameOf(variable_->keyCode);
    keys.append(name.isEmpty() ? key_->currentText() : name);
    QString presses = tr("Presses %1").arg(keys.join(QLatin1Char('+')));
    if (variable_->count > 1) presses = tr("%1, %2 times").arg(presses).arg(variable_->count);
    if (variable_->delay > 0)
        presses = tr("%1, after %2 seconds").arg(presses, locale().toString(variable_->delay, 'g'));
    return {presses, remark_};
}

// ---- Recording ----

bool KeyForm::eventFilter(QObject* watched, QEvent* event) {
    if (watched != record_ || !recording_) return ChipForm::eventFilter(watched, event);
    if (event->type() == QEvent::FocusOut) endRecording();
    if (event->type() == QEvent::ShortcutOverride) event->accept();
    if (event->type() != QEvent::KeyPress) return false;
    // Keys come another way; this one has not, so Plume hears none.
    if (static_cast<const QKeyEvent*>(event)->key() == Qt::Key_Escape) endRecording();
    return true;
}

void KeyForm::beginRecording() {
    if (recording_) return endRecording();
    recording_ = true;
    remark_.clear();
    record_->setFocus();
    record_->setText(tr("Press a key… (Escape ends)"));
    patience_.start();
    showValue();
    services().beginRecordingKey([form = QPointer(this)](const GeneralHotKey& key) {
        if (form && form->recording_) form->heard(key);
    });
}

void KeyForm::endRecording() {
    if (!recording_) return;
    recording_ = false;
    patience_.stop();
    record_->setText(tr("&Record"));
    if (services().endRecordingKey) services().endRecordingKey();
    showValue();
}

void KeyForm::heard(const GeneralHotKey& key) {
    if (key.keyCode == KeyCode::None) return;  // modifiers alone
    endRecording();
    if (key == GeneralHotKey{{}, KeyCode::Escape}) return;
    variable_->modifiers = (variable_->modifiers - ModifierFlags) | flagsFromModifiers(key.modifiers);
    for (const auto& [flag, tick] : modifiers_) {
        const QSignalBlocker silent(tick);
        tick->setChecked(variable_->modifiers.contains(flag));
    }
    if (key_->findData(numberOf(key.keyCode)) < 0) {
        const QString name = nameOf(key.keyCode);
        key_->addItem(name.isEmpty() ? tr("Key %1").arg(numberOf(key.keyCode)) : name, numberOf(key.keyCode));
    }
    const QSignalBlocker once(key_);
    key_->setCurrentIndex(key_->findData(numberOf(key.keyCode)));
    setKey(key.keyCode);
}

}  // namespace plume
