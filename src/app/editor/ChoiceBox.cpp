#include "app/editor/ChoiceBox.h"

#include <QSignalBlocker>

#include "app/qt/WheelGuard.h"

namespace plume {

ChoiceBox::ChoiceBox(const QStringList& choices, QWidget* parent)
    : QComboBox(parent), known_(static_cast<int>(choices.size())) {
    addItems(choices);
    ignoreWheelWithoutFocus(*this);
    connect(this, &QComboBox::currentIndexChanged, this, &ChoiceBox::choose);
}

void ChoiceBox::showValue(std::int64_t value) {
    const QSignalBlocker quiet(this);
    value_ = value;
    const bool isKnown = value >= 0 && value < known_;
    if (count() > known_) removeItem(known_);
    if (!isKnown) addItem(tr("Other (%1)").arg(value));
    setCurrentIndex(isKnown ? static_cast<int>(value) : known_);
}

void ChoiceBox::choose(int index) {
    if (index < 0 || index >= known_ || index == value_) return;
    showValue(index);
    Q_EMIT chosen(value_);
}

}  // namespace plume
