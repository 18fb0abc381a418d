#include "app/editor/InputSourcesEdit.h"

#include <QHBoxLayout>
#include <QLineEdit>
#include <QListView>
#include <QPushButton>
#include <QStandardItemModel>
#include <QVBoxLayout>
#include <algorithm>

#include "Foundation/Strings.h"
#include "app/editor/ChoiceBox.h"
#include "app/qt/Text.h"
#include "library/PLFunctionAvailability.h"

namespace plume {

namespace {

constexpr int LayoutRows = 4;
constexpr int IdentifierRole = Qt::UserRole;

}  // namespace

InputSourcesEdit::InputSourcesEdit(QWidget* parent)
    : QWidget(parent),
      option_(new ChoiceBox({tr("With all layouts"), tr("With all layouts except those checked below"),
                             tr("Only with the layouts checked below")})),
      rows_(new QStandardItemModel(this)),
      view_(new QListView),
      another_(new QLineEdit),
      list_(makeList()) {
    option_->setAccessibleName(tr("Keyboard layouts"));
    setFocusProxy(option_);
    auto* layout = new QVBoxLayout(this);
    layout->setContentsMargins(0, 0, 0, 0);
    layout->addWidget(option_);
    layout->addWidget(list_);
    connect(option_, &ChoiceBox::chosen, this, [this](std::int64_t option) {
        showOption();
        Q_EMIT optionChanged(option);
    });
    connect(rows_, &QStandardItemModel::itemChanged, this, [this](const QStandardItem* row) { choose(*row); });
    showOption();
}

QWidget* InputSourcesEdit::makeList() {
    view_->setModel(rows_);
    view_->setUniformItemSizes(true);
    view_->setEditTriggers(QAbstractItemView::NoEditTriggers);
    view_->setFixedHeight(fontMetrics().height() * LayoutRows * 3 / 2);
    view_->setAccessibleName(tr("Chosen keyboard layouts"));
    another_->setAccessibleName(tr("Another layout"));
    another_->setPlaceholderText(tr("Another layout, like “de(nodeadkeys)”"));
    auto* add = new QPushButton(tr("Add Layout"));
    add->setEnabled(false);
    auto* line = new QHBoxLayout;
    line->addWidget(another_, 1);
    line->addWidget(add);
    auto* list = new QWidget(this);
    auto* layout = new QVBoxLayout(list);
    layout->setContentsMargins(0, 0, 0, 0);
    layout->addWidget(view_);
    layout->addLayout(line);
    connect(another_, &QLineEdit::textChanged, add,
            [add](const QString& text) { add->setEnabled(!text.trimmed().isEmpty()); });
    connect(another_, &QLineEdit::returnPressed, this, &InputSourcesEdit::addTyped);
    connect(add, &QPushButton::clicked, this, &InputSourcesEdit::addTyped);
    return list;
}

void InputSourcesEdit::setKnown(const Known& known) {
    if (known == known_) return;
    known_ = known;
    showRows();
}

void InputSourcesEdit::setSources(std::int64_t option, const Identifiers& identifiers) {
    option_->showValue(option);
    showOption();
    if (identifiers == identifiers_) return;
    identifiers_ = identifiers;
    showRows();
}

std::int64_t InputSourcesEdit::option() const {
    return option_->value();
}

QString InputSourcesEdit::nameOf(const std::u16string& identifier) const {
    const auto found =
        std::find_if(known_.begin(), known_.end(), [&](const auto& each) { return each.first == identifier; });
    return found == known_.end() || found->second.isEmpty() ? toQString(identifier) : found->second;
}

// Those that are known come first, then what else is chosen.
void InputSourcesEdit::showRows() {
    Identifiers all;
    for (const auto& [identifier, name] : known_) all.push_back(identifier);
    for (const std::u16string& each : identifiers_) {
        if (std::find(all.begin(), all.end(), each) == all.end()) all.push_back(each);
    }
    const int current = std::max(view_->currentIndex().row(), 0);
    isShowing_ = true;
    rows_->clear();
    for (const std::u16string& identifier : all) {
        auto* row = new QStandardItem(nameOf(identifier));
        row->setData(toQString(identifier), IdentifierRole);
        row->setToolTip(toQString(identifier));
        row->setCheckable(true);
        const bool isChosen = std::find(identifiers_.begin(), identifiers_.end(), identifier) != identifiers_.end();
        row->setCheckState(isChosen ? Qt::Checked : Qt::Unchecked);
        rows_->appendRow(row);
    }
    isShowing_ = false;
    view_->setCurrentIndex(rows_->index(std::min(current, rows_->rowCount() - 1), 0));
}

void InputSourcesEdit::showOption() {
    list_->setVisible(option_->value() != PLFunctionAvailability::Everywhere);
}

void InputSourcesEdit::choose(const QStandardItem& row) {
    if (isShowing_) return;
    const std::u16string identifier = fromQString(row.data(IdentifierRole).toString());
    Identifiers chosen = identifiers_;
    chosen.erase(std::remove(chosen.begin(), chosen.end(), identifier), chosen.end());
    if (row.checkState() == Qt::Checked) chosen.push_back(identifier);
    if (chosen == identifiers_) return;
    identifiers_ = chosen;
    Q_EMIT identifiersChanged(identifiers_);
}

void InputSourcesEdit::addTyped() {
    const std::u16string identifier(trimmed(fromQString(another_->text())));
    if (identifier.empty()) return;
    another_->clear();
    if (std::find(identifiers_.begin(), identifiers_.end(), identifier) != identifiers_.end()) return;
    identifiers_.push_back(identifier);
    showRows();
    Q_EMIT identifiersChanged(identifiers_);
}

}  // namespace plume
