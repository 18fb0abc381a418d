// The form of a key that is pressed in the middle of a text: which one, how often and how late.
//
// The key is chosen from a list, or recorded: the next key that is pressed is taken, with its modifiers. A recording
// ends with that key, with Escape, when the button loses the focus, and after ten seconds. On the main thread; owns
// itself as every form does.
#pragma once

#include <QTimer>

#include "app/editor/ChipForm.h"
#include "content/SnippetKeyVariable.h"

class QCheckBox;
class QComboBox;
class QPushButton;

namespace plume {

class KeyForm final : public ChipForm {
    Q_OBJECT
  public:
    KeyForm(ChipFormServices services, std::shared_ptr<SnippetKeyVariable> variable);
    ~KeyForm() override;

  protected:
    Shown shown() const override;
    bool eventFilter(QObject* watched, QEvent* event) override;

  private:
    void addKeyRow();
    void addModifierRow();
    void addTimesRows();
    void addKey(KeyCode key);
    void setKey(KeyCode key);
    void setFlag(EventFlag flag, bool isOn);
    QString nameOf(KeyCode key) const;

    void beginRecording();
    void endRecording();
    void heard(const GeneralHotKey& key);

    const std::shared_ptr<SnippetKeyVariable> variable_;
    QComboBox* key_ = nullptr;
    QPushButton* record_ = nullptr;
    std::vector<std::pair<EventFlag, QCheckBox*>> modifiers_;
    QTimer patience_{this};
    bool recording_ = false;
    QString remark_;  // how a recording ended
};

}  // namespace plume
