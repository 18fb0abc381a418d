// What the forms of dates and of times have in common: the style or pattern, and the language.
//
// On the main thread; owns itself as every form does.
#pragma once

#include "app/editor/ChipForm.h"
#include "app/editor/FormControls.h"
#include "content/DateFormatters.h"
#include "content/SnippetDateTimeVariable.h"

class QComboBox;
class QLineEdit;
class QToolButton;

namespace plume {

class DateTimeForm : public ChipForm {
    Q_OBJECT
  protected:
    DateTimeForm(const QString& title, ChipFormServices services, std::shared_ptr<SnippetDateTimeVariable> variable,
                 DateTextKind kind);

    Shown shown() const override;
    void addFormatRows();
    void addLocaleRow();
    // A whole number that is added, as "Days: 2".
    QWidget* makeOffset(std::int64_t& offset, const QString& unit, const QString& name);

  private:
    void fillStyles();
    void styleChosen();
    QToolButton* makePatternHelp();
    QString inFormat(const std::u16string& format) const;

    const std::shared_ptr<SnippetDateTimeVariable> variable_;
    const DateTextKind kind_;
    QComboBox* style_ = nullptr;
    QLineEdit* pattern_ = nullptr;
    QWidget* patternRow_ = nullptr;
};

}  // namespace plume
