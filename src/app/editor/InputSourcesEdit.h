// A field for the keyboard layouts with which something is done: all, all but some, or only some.
//
// Main thread. It is changed by the user, which is told, and by setSources(), which is not.
#pragma once

#include <QWidget>
#include <cstdint>
#include <functional>
#include <string>
#include <utility>
#include <vector>

class QLineEdit;
class QListView;
class QStandardItem;
class QStandardItemModel;

namespace plume {

class ChoiceBox;

class InputSourcesEdit final : public QWidget {
    Q_OBJECT
  public:
    using Identifiers = std::vector<std::u16string>;
    using Known = std::vector<std::pair<std::u16string, QString>>;

    explicit InputSourcesEdit(QWidget* parent = nullptr);

    // Those that can be chosen by name.
    void setKnown(const Known& known);
    // The option is that of PLFunctionAvailability.
    void setSources(std::int64_t option, const Identifiers& identifiers);
    std::int64_t option() const;
    const Identifiers& identifiers() const { return identifiers_; }
    // The identifier itself when nobody knows it.
    QString nameOf(const std::u16string& identifier) const;

    Q_SIGNAL void optionChanged(std::int64_t option);
    Q_SIGNAL void identifiersChanged(const std::vector<std::u16string>& identifiers);

  private:
    QWidget* makeList();
    void choose(const QStandardItem& row);
    void addTyped();
    void showRows();
    void showOption();

    Known known_;
    Identifiers identifiers_;
    bool isShowing_ = false;
    ChoiceBox* option_;
    QStandardItemModel* rows_;
    QListView* view_;
    QLineEdit* another_;
    QWidget* list_;
};

}  // namespace plume
