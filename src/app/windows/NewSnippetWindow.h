// Makes one snippet and puts it into the library.
//
// On the main thread; owns itself, and is gone when it is closed. The library outlives it.
#pragma once

#include <memory>
#include <vector>

#include "app/windows/SmallWindow.h"
#include "library/DataManager.h"

class QComboBox;
class QFormLayout;
class QLabel;
class QLineEdit;
class QPlainTextEdit;

namespace plume {

class NewSnippetWindow final : public SmallWindow {
    Q_OBJECT
  public:
    NewSnippetWindow(DataManager& manager, const std::u16string& content, WritableUserDefaults& settings);

  protected:
    // What was typed is not thrown away without a question.
    void closeEvent(QCloseEvent* event) override;

  private:
    void makeForm(QFormLayout& form);
    void fillGroups();
    void groupChosen();
    void showWarning();
    void accept() override;
    bool isNewGroupChosen() const;
    // Null for one that is yet to be made.
    std::shared_ptr<SnippetGroup> chosenGroup() const;
    // Makes it if need be.
    std::shared_ptr<SnippetGroup> groupToFill();
    bool hasEdits() const;

    DataManager& manager_;
    // As in the choice. Groups that a download has replaced meanwhile are found by their names.
    std::vector<std::u16string> groupNames_;
    std::vector<std::weak_ptr<SnippetGroup>> groups_;
    QComboBox* group_;
    QLineEdit* newGroup_;
    QFormLayout* form_ = nullptr;
    QLineEdit* abbreviation_;
    QLabel* warning_;
    QLineEdit* label_;
    QPlainTextEdit* text_;
    const QString draft_;  // what the text was at first
    bool mayClose_ = false;
};

}  // namespace plume
