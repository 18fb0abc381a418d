// A field for a set of delimiters, or for the usual ones.
//
// Main thread. It is changed by the user, which is told, and by setDelimiters(), which is not.
#pragma once

#include <QWidget>
#include <array>
#include <optional>

#include "Foundation/CharacterSet.h"
#include "app/editing/DelimiterNames.h"

class QCheckBox;
class QLabel;

namespace plume {

class TypedLine;

class DelimitersEdit final : public QWidget {
    Q_OBJECT
  public:
    // Nil stands for the usual ones.
    using Delimiters = std::optional<CharacterSet>;

    // What they are for, as the names of the controls begin for those who do not see them.
    explicit DelimitersEdit(const QString& purpose, QWidget* parent = nullptr);
    ~DelimitersEdit() override;
    DelimitersEdit(const DelimitersEdit&) = delete;
    DelimitersEdit& operator=(const DelimitersEdit&) = delete;

    void setDelimiters(const Delimiters& delimiters);
    const Delimiters& delimiters() const { return delimiters_; }
    // Tells what was typed and has not been told yet.
    void finish();

    Q_SIGNAL void changed(const std::optional<CharacterSet>& delimiters);

  private:
    static QStringList namesInOrder();  // of the named ones
    static QString usualOnes();
    QWidget* makeOwn(const QString& purpose);
    void choose(const Delimiters& delimiters);
    void chooseOthers(const std::u16string& text);
    void showDelimiters();
    void showOthers(const CharacterSet& others);

    Delimiters delimiters_;
    QCheckBox* usual_;
    QLabel* usualOnes_;
    std::array<QCheckBox*, NamedDelimiters.size()> named_{};
    TypedLine* others_;
    QWidget* own_;
};

}  // namespace plume
