#include "app/windows/NewSnippetWindow.h"

#include <QCloseEvent>
#include <QComboBox>
#include <QDialogButtonBox>
#include <QFormLayout>
#include <QLabel>
#include <QLineEdit>
#include <QPlainTextEdit>
#include <QPushButton>
#include <QShortcut>
#include <QTextDocument>
#include <QVBoxLayout>
#include <algorithm>

#include "app/qt/Labels.h"
#include "app/qt/Messages.h"
#include "app/qt/Text.h"
#include "app/qt/WheelGuard.h"
#include "app/qt/WindowPlaces.h"

namespace plume {

namespace {

// Qt's own plain text has spaces in place of those that do not break.
QString textIn(const QPlainTextEdit& field) {
    return field.document()->toRawText().replace(QChar::ParagraphSeparator, QLatin1Char('\n'));
}

}  // namespace

NewSnippetWindow::NewSnippetWindow(DataManager& manager, const SnippetDraft& draft, WritableUserDefaults& settings)
    : SmallWindow(draft.edited ? tr("Edit Snippet") : tr("New Snippet")),
      manager_(manager),
      group_(new QComboBox),
      newGroup_(new QLineEdit(tr("My Snippets"))),
      abbreviation_(new QLineEdit),
      warning_(makeTextLabel()),
      label_(new QLineEdit),
      text_(new QPlainTextEdit(toQString(draft.content))),
      edited_(draft.edited),
      draft_(textIn(*text_)) {
    auto* buttons = new QDialogButtonBox;
    const QString purpose = edited_ ? tr("&Save Changes") : tr("Add &Snippet");
    buttons->addButton(purpose, QDialogButtonBox::AcceptRole)->setDefault(true);
    buttons->addButton(tr("&Cancel"), QDialogButtonBox::RejectRole);
    connect(buttons, &QDialogButtonBox::accepted, this, &NewSnippetWindow::accept);
    connect(buttons, &QDialogButtonBox::rejected, this, &QDialog::reject);
    // Return in the text is a new line.
    const auto* shortcut = new QShortcut(QKeySequence(Qt::CTRL | Qt::Key_Return), this);
    connect(shortcut, &QShortcut::activated, this, &NewSnippetWindow::accept);

    auto* layout = new QVBoxLayout(this);
    form_ = new QFormLayout;
    makeForm(*form_);
    layout->addLayout(form_, 1);
    layout->addWidget(buttons);
    fillGroups();
    if (edited_) showEdited();
    groupChosen();
    connect(group_, &QComboBox::currentIndexChanged, this, &NewSnippetWindow::groupChosen);
    connect(newGroup_, &QLineEdit::textChanged, this, &NewSnippetWindow::showWarning);
    connect(abbreviation_, &QLineEdit::textChanged, this, &NewSnippetWindow::showWarning);
    abbreviation_->setFocus();
    const int em = fontMetrics().height();
    resize(34 * em, 24 * em);
    rememberPlace(*this, settings, "NewSnippet");
}

void NewSnippetWindow::makeForm(QFormLayout& form) {
    ignoreWheelWithoutFocus(*group_);
    group_->setSizeAdjustPolicy(QComboBox::AdjustToMinimumContentsLengthWithIcon);
    group_->setMinimumContentsLength(12);
    text_->setTabChangesFocus(true);
    label_->setPlaceholderText(tr("Optional: a name for lists"));
    warning_->setAccessibleName(tr("About the abbreviation"));
    // One line is kept free for it: nothing jumps while one types.
    warning_->setMinimumSize(24 * fontMetrics().height(), fontMetrics().lineSpacing());
    form.setFieldGrowthPolicy(QFormLayout::AllNonFixedFieldsGrow);
    form.addRow(tr("&Group:"), group_);
    form.addRow(tr("Na&me of group:"), newGroup_);
    form.addRow(tr("&Abbreviation:"), abbreviation_);
    form.addRow(QString(), warning_);
    form.addRow(tr("&Label:"), label_);
    form.addRow(tr("&Text:"), text_);
}

void NewSnippetWindow::showEdited() {
    const auto group = edited_->parentGroup();
    const auto isItsGroup = [&](const std::weak_ptr<SnippetGroup>& each) { return each.lock() == group; };
    const auto place = std::find_if(groups_.begin(), groups_.end(), isItsGroup);
    group_->setCurrentIndex(static_cast<int>(place - groups_.begin()));
    group_->setEnabled(false);
    abbreviation_->setText(toQString(edited_->abbreviation().value_or(u"")));
    label_->setText(toQString(edited_->label().value_or(u"")));
    text_->setPlainText(toQString(edited_->plainTextContent().value_or(u"")));
    const bool isFormatted = edited_->contentType() == ContentType::RichText;
    text_->setReadOnly(isFormatted);
    if (isFormatted) text_->setToolTip(tr("Formatted text can be looked at here, and not be changed."));
    draft_ = textIn(*text_);
}

void NewSnippetWindow::fillGroups() {
    for (const auto& group : manager_.snippetGroups()) {
        const std::u16string name = group->name().value_or(u"");
        group_->addItem(name.empty() ? tr("Untitled group") : toQString(name));
        groupNames_.push_back(name);
        groups_.push_back(group);
    }
    group_->addItem(tr("New Group…"));
    group_->setCurrentIndex(0);
}

bool NewSnippetWindow::isNewGroupChosen() const {
    return group_->currentIndex() == static_cast<int>(groups_.size());
}

std::shared_ptr<SnippetGroup> NewSnippetWindow::chosenGroup() const {
    if (isNewGroupChosen()) return manager_.groupWithName(fromQString(newGroup_->text().trimmed()));
    const auto row = static_cast<std::size_t>(group_->currentIndex());
    const auto& groups = manager_.snippetGroups();
    auto group = groups_[row].lock();
    if (group && std::find(groups.begin(), groups.end(), group) != groups.end()) return group;
    return manager_.groupWithName(groupNames_[row]);
}

void NewSnippetWindow::groupChosen() {
    const bool isNew = isNewGroupChosen();
    newGroup_->setVisible(isNew);
    form_->labelForField(newGroup_)->setVisible(isNew);
    showWarning();
}

void NewSnippetWindow::showWarning() {
    const std::u16string abbreviation = fromQString(abbreviation_->text());
    const auto group = chosenGroup();
    const auto other = group && !abbreviation.empty() ? group->findSnippetWithAbbreviation(abbreviation) : nullptr;
    const bool isItself = other && edited_ && (other == edited_ || other == livingSnippet());
    if (abbreviation.empty()) {
        warning_->setText(tr("Without an abbreviation it can only be chosen from lists."));
    } else if (other && !isItself) {
        warning_->setText(tr("The group has this abbreviation already. Both will be kept."));
    } else {
        warning_->clear();
    }
}

void NewSnippetWindow::accept() {
    edited_ ? change() : add();
    manager_.notifyDataChanged();
    mayClose_ = true;
    close();
}

// One that the library has lost meanwhile comes back with its changes.
void NewSnippetWindow::change() {
    const auto living = livingSnippet();
    const auto snippet = living ? living : edited_;
    const std::u16string abbreviation = fromQString(abbreviation_->text());
    const std::u16string label = fromQString(label_->text());
    const bool hasOtherAbbreviation = abbreviation != edited_->abbreviation().value_or(u"");
    const bool hasOtherLabel = label != edited_->label().value_or(u"");
    if (hasOtherAbbreviation) snippet->setAbbreviation(abbreviation);
    if (hasOtherLabel) snippet->setLabel(label);
    if (textIn(*text_) != draft_) snippet->setPlainTextContent(fromQString(textIn(*text_)));
    if (!living) groupToFill()->addItem(snippet);
}

std::shared_ptr<Snippet> NewSnippetWindow::livingSnippet() const {
    const auto isIt = [this](const std::shared_ptr<Snippet>& each) {
        return each == edited_ || (edited_->uuid() && each->uuid() == edited_->uuid());
    };
    for (const auto& group : manager_.snippetGroups()) {
        const auto found = std::find_if(group->items().begin(), group->items().end(), isIt);
        if (found != group->items().end()) return *found;
    }
    return nullptr;
}

std::shared_ptr<SnippetGroup> NewSnippetWindow::groupToFill() {
    if (auto group = chosenGroup()) return group;
    const std::u16string name = isNewGroupChosen() ? fromQString(newGroup_->text().trimmed())
                                                   : groupNames_[static_cast<std::size_t>(group_->currentIndex())];
    return manager_.generateSnippetGroupSamples(name.empty() ? fromQString(tr("My Snippets")) : name, {});
}

void NewSnippetWindow::add() {
    auto snippet = std::make_shared<Snippet>(fromQString(abbreviation_->text()), fromQString(textIn(*text_)));
    if (!label_->text().isEmpty()) snippet->setLabel(fromQString(label_->text()));
    groupToFill()->addItem(snippet);
}

bool NewSnippetWindow::hasEdits() const {
    if (edited_) {
        return abbreviation_->text() != toQString(edited_->abbreviation().value_or(u"")) ||
               label_->text() != toQString(edited_->label().value_or(u"")) || textIn(*text_) != draft_;
    }
    return !abbreviation_->text().isEmpty() || !label_->text().isEmpty() || textIn(*text_) != draft_;
}

void NewSnippetWindow::closeEvent(QCloseEvent* event) {
    if (mayClose_ || !hasEdits()) return SmallWindow::closeEvent(event);
    event->ignore();
    const auto throwAway = [this] {
        mayClose_ = true;
        close();
    };
    if (edited_) {
        ask(this, tr("Do you want to throw your changes away?"), tr("They were not saved yet."), tr("Throw Away"),
            throwAway);
    } else {
        ask(this, tr("Do you want to throw this snippet away?"), tr("It was not added to your snippets yet."),
            tr("Throw Away"), throwAway);
    }
}

}  // namespace plume
