// The form of a snippet within a snippet: which one, chosen from the library by its identity.
//
// On the main thread; owns itself as every form does. The line keeps the keyboard while one chooses: arrows move.
#pragma once

#include "app/editor/ChipForm.h"
#include "content/SnippetAbbreviationVariable.h"

class QLineEdit;
class QListView;
class QModelIndex;

namespace plume {

class InsertModel;

class SnippetForm final : public ChipForm {
    Q_OBJECT
  public:
    SnippetForm(ChipFormServices services, std::shared_ptr<SnippetAbbreviationVariable> variable);

  protected:
    Shown shown() const override;
    bool eventFilter(QObject* watched, QEvent* event) override;

  private:
    void makeList();
    void search();
    void choose(const QModelIndex& index);
    // What the placeholder names now; null when the library has it not.
    std::shared_ptr<Snippet> named() const;

    const std::shared_ptr<SnippetAbbreviationVariable> variable_;
    InsertModel* model_;
    QLineEdit* query_;
    QListView* list_;
};

}  // namespace plume
