// The settings of a group: its name, when and where its snippets expand.
//
// Each change is made at once; there is nothing to save. A line that is being typed in is kept when it is left, on
// Return, and half a second after the last key. Main thread; the editor's window owns it.
#pragma once

#include <QWidget>
#include <cstdint>
#include <functional>
#include <memory>
#include <string>
#include <utility>
#include <vector>

#include "app/editing/LibraryEditor.h"
#include "app/preferences/ProgramCatalog.h"
#include "app/preferences/ProgramServices.h"

class QCheckBox;
class QFormLayout;
class QLabel;
class QPushButton;
class QScrollArea;

namespace plume {

class ApplicationList;
class ChoiceBox;
class DelimitersEdit;
class InputSourcesEdit;
class TypedLine;

// All of it outlives the editor.
struct GroupEditorServices {
    LibraryEditor& editor;
    ProgramServices applications;
    // The keyboard layouts that the desktop has, with their names.
    std::function<std::vector<std::pair<std::u16string, QString>>()> inputSources;
};

class GroupEditor : public QWidget {
    Q_OBJECT
  public:
    explicit GroupEditor(GroupEditorServices services, QWidget* parent = nullptr);
    ~GroupEditor() override;
    GroupEditor(const GroupEditor&) = delete;
    GroupEditor& operator=(const GroupEditor&) = delete;

    using QWidget::show;
    // What was typed for the one before is kept. Null clears the fields.
    void show(const std::shared_ptr<SnippetGroup>& group);
    // The record was changed elsewhere: nothing is told.
    void refresh();
    // Keeps what is being typed. Before the editor goes, and before the library is changed otherwise.
    void finish();

  private:
    using Change = std::function<void(SnippetGroup&)>;

    // ---- From the top down ----
    void addNames();
    void addExpansion();
    void addNewSnippets();
    void addWhere();
    void addHeading(const QString& text);
    void addField(const QString& label, QWidget* field);
    ChoiceBox* addChoice(const QString& label, const QStringList& choices,
                         const std::function<std::int64_t(const SnippetGroup&)>& value,
                         const std::function<void(SnippetGroup&, std::int64_t)>& set);
    DelimitersEdit* addDelimiters(const QString& label,
                                  const std::function<std::optional<CharacterSet>(const SnippetGroup&)>& value,
                                  const std::function<void(SnippetGroup&, std::optional<CharacterSet>)>& set);
    void addCheckBox(const QString& label, const std::function<bool(const SnippetGroup&)>& value,
                     const std::function<void(SnippetGroup&, bool)>& set);
    void addPrograms();
    void addKeyboards();

    bool isListed() const;
    void change(const Change& change);
    void showValues(const SnippetGroup& group);
    void showWhatMatters(const SnippetGroup& group);
    void askForReset();

    const GroupEditorServices services_;
    ProgramCatalog programs_;
    std::shared_ptr<SnippetGroup> group_;
    std::vector<std::function<void(const SnippetGroup&)>> shows_;
    QLabel* effect_;
    QScrollArea* area_;
    QFormLayout* form_;
    DelimitersEdit* before_ = nullptr;
    DelimitersEdit* behind_ = nullptr;
    QPushButton* reset_ = nullptr;
    ApplicationList* applications_ = nullptr;
    InputSourcesEdit* inputSources_ = nullptr;
};

}  // namespace plume
