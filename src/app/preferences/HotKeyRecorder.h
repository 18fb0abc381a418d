// A field that shows a hot key and records another one: any key with modifiers, or modifiers alone.
//
// A click, Return or Space begins. Escape leaves the hot key as it is, Backspace and Delete clear it. What cannot be a
// hot key is refused, with the reason below the field. Main thread. However a recording ends, also with the widget,
// keys go where they went before.
#pragma once

#include <QTimer>
#include <QWidget>
#include <functional>
#include <optional>

#include "app/preferences/PreferencesServices.h"

class QLabel;
class QLineEdit;
class QPushButton;

namespace plume {

// "Ctrl+Alt+K"; empty for an invalid one.
QString hotKeyText(const GeneralHotKey& hotKey, const std::function<std::u16string(KeyCode)>& keyName);

class HotKeyRecorder final : public QWidget {
    Q_OBJECT
  public:
    // What else of Plume's has this hot key; empty: nothing.
    using Holder = std::function<QString(const GeneralHotKey&)>;

    // The services outlive it.
    HotKeyRecorder(const PreferencesServices& services, Holder holder, QWidget* parent = nullptr);
    ~HotKeyRecorder() override;

    // For who cannot see the label beside it.
    void setName(const QString& name);
    void setHotKey(const std::optional<GeneralHotKey>& hotKey);
    const std::optional<GeneralHotKey>& hotKey() const { return hotKey_; }
    bool isRecording() const { return recording_; }

  Q_SIGNALS:
    // By the user; nothing: cleared.
    void edited(const std::optional<GeneralHotKey>& hotKey);

  protected:
    bool eventFilter(QObject* object, QEvent* event) override;

  private:
    bool takeKeyPress(int key);
    void begin();
    void end();
    void heard(const GeneralHotKey& hotKey);
    // Why this cannot be a hot key; empty: it can.
    QString refusal(const GeneralHotKey& hotKey) const;
    void askDesktop(const GeneralHotKey& hotKey);
    void take(const std::optional<GeneralHotKey>& hotKey);
    void tell(const QString& words);
    static QString invitation();
    void showState();

    const PreferencesServices& services_;
    const Holder holder_;
    std::optional<GeneralHotKey> hotKey_;
    QLineEdit* field_;
    QPushButton* clear_;
    QLabel* words_;
    QTimer patience_{this};
    bool recording_ = false;
    bool hasHeard_ = false;
    int turn_ = 0;  // an answer to an earlier question is none to this one
};

}  // namespace plume
