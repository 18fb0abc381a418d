#include "app/editor/DelimitersEdit.h"

#include <QCheckBox>
#include <QHBoxLayout>
#include <QLabel>
#include <QSignalBlocker>
#include <QVBoxLayout>

#include "app/editor/TypedLine.h"
#include "app/qt/Labels.h"
#include "app/qt/Text.h"
#include "engine/AutoText.h"

namespace plume {

namespace {

// An archive may hold a set that nobody can read.
constexpr qsizetype MostOthers = 200;

qsizetype memberCount(const CharacterSet& set) {
    qsizetype count = 0;
    for (const auto& [first, last] : set.ranges()) count += static_cast<qsizetype>(last - first) + 1;
    return count;
}

CharacterSet just(char16_t character) {
    return CharacterSet::withRange(character, character);
}

}  // namespace

DelimitersEdit::DelimitersEdit(const QString& purpose, QWidget* parent)
    : QWidget(parent),
      usual_(new QCheckBox(tr("The usual ones"))),
      usualOnes_(makeHelpLabel(usualOnes())),
      others_(new TypedLine),
      own_(makeOwn(purpose)) {
    usual_->setAccessibleName(tr("%1 The usual ones").arg(purpose));
    usual_->setAccessibleDescription(usualOnes_->text());
    setFocusProxy(usual_);
    auto* layout = new QVBoxLayout(this);
    layout->setContentsMargins(0, 0, 0, 0);
    layout->addWidget(usual_, 0, Qt::AlignLeft);
    layout->addWidget(usualOnes_);
    layout->addWidget(own_);
    // Those that were the usual ones are where one's own begin.
    connect(usual_, &QCheckBox::toggled, this,
            [this](bool isUsual) { choose(isUsual ? Delimiters() : Delimiters(AutoText::defaultDelimiters())); });
    connect(others_, &TypedLine::edited, this, &DelimitersEdit::chooseOthers);
    connect(others_, &TypedLine::left, this, &DelimitersEdit::showDelimiters);
    showDelimiters();
}

// The line loses the keyboard when it goes with it, and would tell so.
DelimitersEdit::~DelimitersEdit() {
    others_->disconnect(this);
}

QStringList DelimitersEdit::namesInOrder() {
    return {tr("Space"), tr("Tab"), tr("Return"), tr("Enter")};
}

QString DelimitersEdit::usualOnes() {
    const CharacterSet others = AutoText::defaultDelimiters().subtracting(namedDelimiters());
    return tr("%1 %2").arg(namesInOrder().join(u' '), toQString(textFromDelimiters(others)));
}

QWidget* DelimitersEdit::makeOwn(const QString& purpose) {
    const QStringList names = namesInOrder();
    auto* boxes = new QHBoxLayout;
    for (std::size_t i = 0; i < named_.size(); ++i) {
        const QString& name = names[static_cast<qsizetype>(i)];
        named_[i] = new QCheckBox(name);
        named_[i]->setAccessibleName(tr("%1 %2").arg(purpose, name));
        boxes->addWidget(named_[i]);
        connect(named_[i], &QCheckBox::toggled, this, [this, character = NamedDelimiters[i].character](bool isOne) {
            finish();
            const CharacterSet chosen = delimiters_.value_or(CharacterSet());
            choose(isOne ? chosen.united(just(character)) : chosen.subtracting(just(character)));
        });
    }
    boxes->addStretch(1);
    auto* label = new QLabel(tr("Others:"));
    label->setBuddy(others_);
    others_->setAccessibleName(tr("%1 Others").arg(purpose));
    auto* line = new QHBoxLayout;
    line->addWidget(label);
    line->addWidget(others_, 1);
    auto* own = new QWidget(this);
    auto* layout = new QVBoxLayout(own);
    layout->setContentsMargins(0, 0, 0, 0);
    layout->addLayout(boxes);
    layout->addLayout(line);
    return own;
}

void DelimitersEdit::setDelimiters(const Delimiters& delimiters) {
    if (delimiters == delimiters_) return;
    delimiters_ = delimiters;
    showDelimiters();
}

void DelimitersEdit::finish() {
    others_->finish();
}

void DelimitersEdit::choose(const Delimiters& delimiters) {
    const bool isOther = delimiters != delimiters_;
    delimiters_ = delimiters;
    showDelimiters();
    if (isOther) Q_EMIT changed(delimiters_);
}

// Names that are written out count for their check boxes.
void DelimitersEdit::chooseOthers(const std::u16string& text) {
    if (!delimiters_) return;
    choose(delimiters_->intersected(namedDelimiters()).united(delimitersFromText(text)));
}

void DelimitersEdit::showDelimiters() {
    const QSignalBlocker quiet(usual_);
    usual_->setChecked(!delimiters_);
    usualOnes_->setVisible(!delimiters_);
    own_->setVisible(delimiters_.has_value());
    const CharacterSet shown = delimiters_.value_or(CharacterSet());
    for (std::size_t i = 0; i < named_.size(); ++i) {
        const QSignalBlocker quietBox(named_[i]);
        named_[i]->setChecked(shown.contains(NamedDelimiters[i].character));
    }
    showOthers(shown.subtracting(namedDelimiters()));
}

void DelimitersEdit::showOthers(const CharacterSet& others) {
    const qsizetype count = memberCount(others);
    const bool isReadable = count <= MostOthers;
    // The order in which they are being written stays until the line is left.
    const CharacterSet written = delimitersFromText(fromQString(others_->text())).subtracting(namedDelimiters());
    if (others_->hasFocus() && isReadable && written == others) return;
    others_->showText(isReadable ? textFromDelimiters(others) : std::u16string());
    others_->setReadOnly(!isReadable);
    others_->setPlaceholderText(isReadable ? QString() : tr("%1 characters").arg(count));
}

}  // namespace plume
