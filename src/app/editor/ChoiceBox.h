// One of several numbered choices. A number that is none of them is shown as such, and stays until another is chosen.
//
// Main thread.
#pragma once

#include <QComboBox>
#include <cstdint>
#include <utility>
#include <vector>

namespace plume {

class ChoiceBox final : public QComboBox {
    Q_OBJECT
  public:
    // Numbered from 0 on.
    explicit ChoiceBox(const QStringList& choices, QWidget* parent = nullptr);

    // Nothing is told of this.
    void showValue(std::int64_t value);
    std::int64_t value() const { return value_; }

    Q_SIGNAL void chosen(std::int64_t value);

  private:
    void choose(int index);

    const int known_;
    std::int64_t value_ = 0;
};

}  // namespace plume
