// The form of a placeholder: a control for each of its parameters, and what it gives with them.
//
// On the main thread; owns itself, and is gone when it is closed or with the widget that it was opened at. Return
// accepts, Escape leaves everything as it was. A parameter is written anew only when its control was used; parameters
// that no control knows are kept. There is one form a kind, in a file of its own.
#pragma once

#include <QDialog>
#include <functional>
#include <memory>
#include <string>

#include "app/editor/ChipFormServices.h"
#include "content/SnippetVariable.h"

class QFormLayout;
class QLabel;
class QPushButton;

namespace plume {

class ChipForm : public QDialog {
    Q_OBJECT
  public:
    using Done = std::function<void(std::u16string body)>;

    // `done` gets the body when the form is accepted. Null, and nothing is shown, for a body that has nothing to
    // change: the caret, and what is no placeholder.
    static ChipForm* open(QWidget* at, const std::u16string& body, ChipFormServices services, Done done);

    // As it is accepted now; the one that the form was opened with until a control has been used.
    std::u16string body() const;
    void accept() override;

  protected:
    struct Shown {
        QString value;    // what the placeholder gives
        QString warning;  // what will not work; empty: nothing
    };

    ChipForm(const QString& title, ChipFormServices services, std::shared_ptr<SnippetVariable> variable);

    // What the placeholder gives, with the values of now.
    virtual Shown shown() const = 0;
    // Its controls have been made; they show the variable.
    void showValue();
    // The user has changed the variable.
    void changed();
    // Other rows are shown than before.
    void fitToRows();
    QFormLayout& rows() { return *rows_; }
    const ChipFormServices& services() const { return services_; }
    // Whether the form that fills in lets the user leave it out.
    void addOptionalRow();

  private:
    // Below the controls, and reached by Tab after them.
    void addFoot();
    // Beside the place, on its screen.
    void placeAt(const QWidget& at);

    const ChipFormServices services_;
    const std::shared_ptr<SnippetVariable> variable_;
    std::u16string original_;
    Done done_;
    bool isChanged_ = false;
    QFormLayout* rows_;
    QLabel* value_;
    QLabel* warning_;
    QPushButton* accept_ = nullptr;  // until the form is open
};

}  // namespace plume
