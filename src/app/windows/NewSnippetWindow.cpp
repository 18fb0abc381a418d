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
#include <QVBoxLayout>
#include <algorithm>

#include "app/qt/Labels.h"
#include "app/qt/Messages.h"
#include "app/qt/RawText.h"
#include "app/qt/Text.h"
#include "app/qt/WheelGuard.h"
#include "app/qt/WindowPlaces.h"

namespace plume {

NewSnippetWindow::NewSnippetWindow(DataManager& manager, const std::u16string& content, WritableUserDefaults& settings)
    : SmallWindow(tr("New Snippet")),
      manager_(manager),
      group_(new QComboBox),
      newGroup_(new QLineEdit(tr("My Snippets"))),
      abbreviation_(new QLineEdit),
      warning_(makeTextLabel()),
      label_(new QLineEdit),
      text_(new QPlainTextEdit(toQString(content))),
      draft_(rawText(*text_->document())) {
    auto* buttons = new QDialogButtonBox;
    buttons->addButton(tr("Add &Snippet"), QDialogButtonBox::AcceptRole)->setDefault(true);
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
    if (abbreviation.empty()) {
        warning_->setText(tr("Without an abbreviation it can only be chosen from lists."));
    } else if (other) {
        warning_->setText(tr("The group has this abbreviation already. Both will be kept."));
    } else {
        warning_->clear();
    }
}

void NewSnippetWindow::accept() {
    auto snippet =
        std::make_shared<Snippet>(fromQString(abbreviation_->text()), fromQString(rawText(*text_->document())));
    if (!label_->text().isEmpty()) snippet->setLabel(fromQString(label_->text()));
    groupToFill()->addItem(snippet);
    manager_.notifyDataChanged();
    mayClose_ = true;
    close();
}

std::shared_ptr<SnippetGroup> NewSnippetWindow::groupToFill() {
    if (auto group = chosenGroup()) return group;
    const std::u16string name = isNewGroupChosen() ? fromQString(newGroup_->text().trimmed())
                                                   : groupNames_[static_cast<std::size_t>(group_->currentIndex())];
    return manager_.generateSnippetGroupSamples(name.empty() ? fromQString(tr("My Snippets")) : name, {});
}

bool NewSnippetWindow::hasEdits() const {
    return !abbreviation_->text().isEmpty() || !label_->text().isEmpty() || rawText(*text_->document()) != draft_;
}

void NewSnippetWindow::closeEvent(QCloseEvent* event) {
    if (mayClose_ || !hasEdits()) return SmallWindow::closeEvent(event);
    event->ignore();
    const auto throwAway = [this] {
        mayClose_ = true;
        close();
    };
    ask(this, tr("Do you want to throw this snippet away?"), tr("It was not added to your snippets yet."),
        tr("Throw Away"), throwAway);
}

}  // namespace plume
