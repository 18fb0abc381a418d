// One field of a form of plain controls, as it stands in the text: its box when it is optional, its input, its problem.
//
// On the main thread. It shows what it is told to, and tells what the user does from inside what the user does.
#pragma once

#include <QString>
#include <string>

#include "app/FormModel.h"
#include "app/form/FieldInput.h"
#include "app/form/InlineText.h"

class QBoxLayout;
class QCheckBox;
class QLabel;

namespace plume {

class FieldControl final : public InlineWidget {
    Q_OBJECT
  public:
    struct Names {
        QString name;         // what the field is called when it is read out
        QString boxText;      // with "&" before its letter
        QString description;  // the text in front of it
    };

    FieldControl(const FormModel::Field& field, const Names& names);

    // What the user is typing into keeps what it shows.
    void display(const FormModel::Field& field, const QString& problem);
    // The user has left it: from here on it shows what it is told to.
    void finishEditing() { isEdited_ = false; }
    std::u16string value() const { return input_.value(); }

    // Null where nothing can be typed or chosen.
    QWidget* input() const;
    QCheckBox* box() const { return box_; }
    bool isLarge() const { return input_.isLarge; }

    void setRoom(int width) override;
    QSize sizeHint() const override;
    bool eventFilter(QObject* object, QEvent* event) override;

    Q_SIGNAL void edited();
    Q_SIGNAL void ticked(bool isOn);
    Q_SIGNAL void left();
    // Return has come, and was for the field or for an input method.
    Q_SIGNAL void keptReturn();
    // It has the focus now.
    Q_SIGNAL void entered();

  protected:
    void paintEvent(QPaintEvent* event) override;

  private:
    void makeBox(const QString& text, bool isScript);
    QWidget* makeWarning();
    void describe(const QString& problem);
    bool filterKey(QKeyEvent& key);

    QBoxLayout* layout_;
    QCheckBox* box_ = nullptr;
    FieldInput input_;
    QWidget* warning_;  // an icon and the problem
    QLabel* problem_;
    const QString name_;
    const QString description_;
    int room_ = 0;  // unknown
    bool isReadonly_;
    bool isEdited_ = false;
    bool isComposing_ = false;  // an input method has the keys
};

// The name of a script, where its output comes.
class ScriptMark final : public InlineWidget {
    Q_OBJECT
  public:
    explicit ScriptMark(const QString& name);

    void setRoom(int width) override;
    QSize sizeHint() const override;

  private:
    QLabel* label_;
    int room_ = 0;
};

}  // namespace plume
