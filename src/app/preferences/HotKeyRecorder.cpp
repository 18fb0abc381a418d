#include "app/preferences/HotKeyRecorder.h"

#include <QHBoxLayout>
#include <QKeyEvent>
#include <QLabel>
#include <QLineEdit>
#include <QPointer>
#include <QPushButton>
#include <QVBoxLayout>
#include <algorithm>
#include <array>

#include "app/qt/Sentences.h"
#include "app/qt/Text.h"

namespace plume {

namespace {

constexpr int Patience = 10000;  // milliseconds
constexpr int FieldMargin = 24;
constexpr int ButtonSpacing = 6;

// Keys that write nothing.
constexpr std::array SilentKeys{
    KeyCode::F1,   KeyCode::F2,       KeyCode::F3,         KeyCode::F4,   KeyCode::F5,     KeyCode::F6,
    KeyCode::F7,   KeyCode::F8,       KeyCode::F9,         KeyCode::F10,  KeyCode::F11,    KeyCode::F12,
    KeyCode::F13,  KeyCode::F14,      KeyCode::F15,        KeyCode::F16,  KeyCode::F17,    KeyCode::F18,
    KeyCode::F19,  KeyCode::F20,      KeyCode::Escape,     KeyCode::Menu, KeyCode::Help,   KeyCode::Home,
    KeyCode::End,  KeyCode::PageUp,   KeyCode::PageDown,   KeyCode::Left, KeyCode::Right,  KeyCode::Up,
    KeyCode::Down, KeyCode::VolumeUp, KeyCode::VolumeDown, KeyCode::Mute, KeyCode::Delete, KeyCode::ForwardDelete,
    KeyCode::Eisu, KeyCode::Kana,     KeyCode::CapsLock,   KeyCode::None,
};
constexpr auto LastNamedKey = KeyCode::Up;

bool isTyped(KeyCode key) {
    return key <= LastNamedKey && std::find(SilentKeys.begin(), SilentKeys.end(), key) == SilentKeys.end();
}

bool isAlone(const GeneralHotKey& hotKey, KeyCode key) {
    return hotKey.modifiers.isEmpty() && hotKey.keyCode == key;
}

}  // namespace

QString hotKeyText(const GeneralHotKey& hotKey, const std::function<std::u16string(KeyCode)>& keyName) {
    QStringList words;
    const auto add = [&](KeyModifier modifier, const QString& word) {
        if (hotKey.modifiers.contains(modifier)) words.append(word);
    };
    add(KeyModifier::Control, HotKeyRecorder::tr("Ctrl"));
    add(KeyModifier::Option, HotKeyRecorder::tr("Alt"));
    add(KeyModifier::Shift, HotKeyRecorder::tr("Shift"));
    add(KeyModifier::Command, HotKeyRecorder::tr("Super"));
    if (hotKey.keyCode != KeyCode::None) {
        const QString name = keyName ? toQString(keyName(hotKey.keyCode)) : QString();
        words.append(name.isEmpty() ? HotKeyRecorder::tr("Key %1").arg(numberOf(hotKey.keyCode)) : name);
    }
    return words.join(u'+');
}

HotKeyRecorder::HotKeyRecorder(const PreferencesServices& services, Holder holder, QWidget* parent)
    : QWidget(parent),
      services_(services),
      holder_(std::move(holder)),
      field_(new QLineEdit),
      clear_(new QPushButton(tr("Clear"))),
      words_(new QLabel) {
    field_->setReadOnly(true);
    field_->setContextMenuPolicy(Qt::NoContextMenu);
    field_->setMinimumWidth(fontMetrics().horizontalAdvance(invitation()) + FieldMargin);
    field_->installEventFilter(this);
    setFocusProxy(field_);
    setFocusPolicy(Qt::StrongFocus);
    words_->setWordWrap(true);
    words_->hide();
    patience_.setSingleShot(true);
    patience_.setInterval(Patience);

    auto* row = new QHBoxLayout;
    row->setSpacing(ButtonSpacing);
    row->addWidget(field_, 1);
    row->addWidget(clear_);
    auto* layout = new QVBoxLayout(this);
    layout->setContentsMargins(0, 0, 0, 0);
    layout->setSpacing(2);
    layout->addLayout(row);
    layout->addWidget(words_);
    setSizePolicy(QSizePolicy::Expanding, QSizePolicy::Preferred);

    connect(clear_, &QPushButton::clicked, this, [this] {
        end();
        tell({});
        take(std::nullopt);
    });
    connect(&patience_, &QTimer::timeout, this, [this] {
        if (!hasHeard_) tell(tr("Nothing was heard. Plume may not hear the keyboard at the moment."));
        end();
    });
    showState();
}

HotKeyRecorder::~HotKeyRecorder() {
    if (recording_) services_.endRecordingHotKey();
}

void HotKeyRecorder::setName(const QString& name) {
    setAccessibleName(name);
    field_->setAccessibleName(name);
    clear_->setAccessibleName(tr("Clear the hot key: %1").arg(name));
}

void HotKeyRecorder::setHotKey(const std::optional<GeneralHotKey>& hotKey) {
    hotKey_ = hotKey;
    showState();
}

bool HotKeyRecorder::eventFilter(QObject* object, QEvent* event) {
    switch (event->type()) {
        case QEvent::MouseButtonPress:
            begin();
            break;
        case QEvent::ShortcutOverride:
            // Nothing of the window's happens by a key that is recorded.
            if (recording_) event->accept();
            return recording_;
        case QEvent::KeyPress:
            return takeKeyPress(static_cast<QKeyEvent*>(event)->key());
        case QEvent::FocusOut:
            end();
            break;
        default:
            break;
    }
    return QWidget::eventFilter(object, event);
}

bool HotKeyRecorder::takeKeyPress(int key) {
    if (key == Qt::Key_Tab || key == Qt::Key_Backtab) return false;
    if (recording_) {
        // Keys come another way; this one has not, so Plume hears none.
        if (key == Qt::Key_Escape) end();
        return true;
    }
    if (key == Qt::Key_Return || key == Qt::Key_Enter || key == Qt::Key_Space) return begin(), true;
    if (key != Qt::Key_Backspace && key != Qt::Key_Delete) return false;
    tell({});
    take(std::nullopt);
    return true;
}

void HotKeyRecorder::begin() {
    if (recording_) return;
    recording_ = true;
    hasHeard_ = false;
    ++turn_;
    tell({});
    showState();
    patience_.start();
    const QPointer<HotKeyRecorder> self(this);
    services_.beginRecordingHotKey([self, turn = turn_](const GeneralHotKey& hotKey) {
        if (self && self->recording_ && self->turn_ == turn) self->heard(hotKey);
    });
}

void HotKeyRecorder::end() {
    if (!recording_) return;
    recording_ = false;
    patience_.stop();
    showState();
    services_.endRecordingHotKey();
}

void HotKeyRecorder::heard(const GeneralHotKey& hotKey) {
    hasHeard_ = true;
    patience_.start();
    if (!hotKey.isValid()) return;
    if (isAlone(hotKey, KeyCode::Escape)) return end();
    if (isAlone(hotKey, KeyCode::Delete) || isAlone(hotKey, KeyCode::ForwardDelete)) {
        end();
        return take(std::nullopt);
    }
    const QString reason = refusal(hotKey);
    tell(reason);
    if (!reason.isEmpty()) return;
    end();
    if (hotKey != hotKey_) askDesktop(hotKey);
}

QString HotKeyRecorder::refusal(const GeneralHotKey& hotKey) const {
    const QString keys = hotKeyText(hotKey, services_.keyName);
    const bool isPlain = hotKey.modifiers.isEmpty() || hotKey.modifiers == KeyModifiers(KeyModifier::Shift);
    if (isPlain && isTyped(hotKey.keyCode)) {
        return tr("%1 would be typed all the time. Hold Ctrl, Alt or Super with it.").arg(keys);
    }
    const QString holder = holder_(hotKey);
    return holder.isEmpty() ? QString() : tr("%1 is the hot key of “%2” already.").arg(keys, holder);
}

void HotKeyRecorder::askDesktop(const GeneralHotKey& hotKey) {
    const QPointer<HotKeyRecorder> self(this);
    services_.tryHotKey(hotKey, [self, hotKey, turn = turn_](const Result<void>& answer) {
        if (!self || self->turn_ != turn) return;
        if (!answer) return self->tell(inUsersLanguage(answer.error().message));
        self->take(hotKey);
    });
}

void HotKeyRecorder::take(const std::optional<GeneralHotKey>& hotKey) {
    ++turn_;
    if (hotKey == hotKey_) return;
    setHotKey(hotKey);
    Q_EMIT edited(hotKey);
}

void HotKeyRecorder::tell(const QString& words) {
    words_->setText(words);
    words_->setVisible(!words.isEmpty());
    field_->setAccessibleDescription(words);
}

QString HotKeyRecorder::invitation() {
    return tr("Press keys… Escape leaves it as it is");
}

void HotKeyRecorder::showState() {
    clear_->setEnabled(hotKey_.has_value());
    field_->setPlaceholderText(recording_ ? invitation() : tr("None"));
    field_->setText(!recording_ && hotKey_ ? hotKeyText(*hotKey_, services_.keyName) : QString());
}

}  // namespace plume
