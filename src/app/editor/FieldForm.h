// The form of a field that is filled in: its name, its kind and how it begins.
//
// On the main thread; owns itself as every form does.
#pragma once

#include "app/editor/ChipForm.h"
#include "content/SnippetFieldVariable.h"

class QCheckBox;
class QComboBox;
class QLineEdit;
class QPlainTextEdit;
class QSpinBox;

namespace plume {

class FieldForm final : public ChipForm {
    Q_OBJECT
  public:
    FieldForm(ChipFormServices services, std::shared_ptr<SnippetFieldVariable> variable);

  protected:
    Shown shown() const override;

  private:
    void addKindRow();
    void addValueRows();
    void addSizeRows();
    // Those that the kind has; the value stays what it is.
    void showKind();
    void valueEdited(std::u16string value);
    void fillFirstChoices();
    std::vector<std::u16string> choices() const;

    const std::shared_ptr<SnippetFieldVariable> variable_;
    QLineEdit* line_ = nullptr;        // the value in one line
    QPlainTextEdit* lines_ = nullptr;  // or in several
    QPlainTextEdit* items_ = nullptr;  // or as a menu
    QComboBox* first_ = nullptr;
    QSpinBox* width_ = nullptr;
    QSpinBox* height_ = nullptr;
    QCheckBox* isReadonly_ = nullptr;
};

}  // namespace plume
