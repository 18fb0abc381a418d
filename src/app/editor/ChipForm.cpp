#include "app/editor/ChipForm.h"

#include <QCheckBox>
#include <QDialogButtonBox>
#include <QFormLayout>
#include <QFrame>
#include <QGuiApplication>
#include <QLabel>
#include <QPushButton>
#include <QScreen>
#include <QShortcut>
#include <QVBoxLayout>
#include <algorithm>
#include <utility>

#include "app/editing/ChipBody.h"
#include "app/editor/ClipboardForm.h"
#include "app/editor/DateForm.h"
#include "app/editor/FieldForm.h"
#include "app/editor/KeyForm.h"
#include "app/editor/SnippetForm.h"
#include "app/editor/TimeForm.h"
#include "app/qt/Labels.h"

namespace plume {

namespace {

constexpr int WidthInLines = 26;

template <class Form, class Kind>
ChipForm* formFor(const std::shared_ptr<SnippetVariable>& variable, const ChipFormServices& services) {
    auto ofKind = std::dynamic_pointer_cast<Kind>(variable);
    return ofKind ? new Form(services, std::move(ofKind)) : nullptr;
}

ChipForm* makeForm(const std::shared_ptr<SnippetVariable>& variable, const ChipFormServices& services) {
    constexpr std::array Makers{
        formFor<DateForm, SnippetDateVariable>,           formFor<TimeForm, SnippetTimeVariable>,
        formFor<ClipboardForm, SnippetClipboardVariable>, formFor<SnippetForm, SnippetAbbreviationVariable>,
        formFor<FieldForm, SnippetFieldVariable>,         formFor<KeyForm, SnippetKeyVariable>,
    };
    for (const auto make : Makers) {
        if (ChipForm* form = make(variable, services)) return form;
    }
    return nullptr;
}

}  // namespace

ChipForm* ChipForm::open(QWidget* at, const std::u16string& body, ChipFormServices services, Done done) {
    services.environment.report = nullptr;
    const auto variable = editablePlaceholder(body);
    ChipForm* form = variable ? makeForm(variable, services) : nullptr;
    if (!form) return nullptr;
    form->original_ = body;
    form->done_ = std::move(done);
    form->setParent(at, form->windowFlags());
    form->addFoot();
    form->showValue();
    form->placeAt(*at);
    form->show();
    form->activateWindow();
    return form;
}

ChipForm::ChipForm(const QString& title, ChipFormServices services, std::shared_ptr<SnippetVariable> variable)
    : services_(std::move(services)),
      variable_(std::move(variable)),
      rows_(new QFormLayout),
      value_(makeTextLabel()),
      warning_(makeTextLabel()) {
    setWindowTitle(title);
    setWindowModality(Qt::WindowModal);
    setAttribute(Qt::WA_DeleteOnClose);
    rows_->setFieldGrowthPolicy(QFormLayout::AllNonFixedFieldsGrow);
    value_->setAccessibleName(tr("What it gives"));
    warning_->setAccessibleName(tr("Warning"));
    // One line is kept free for it: nothing jumps while one types.
    value_->setMinimumHeight(fontMetrics().lineSpacing());
    auto* layout = new QVBoxLayout(this);
    layout->addLayout(rows_, 1);
}

void ChipForm::addFoot() {
    auto* line = new QFrame;
    line->setFrameShape(QFrame::HLine);
    line->setForegroundRole(QPalette::Mid);
    auto* buttons = new QDialogButtonBox;
    accept_ = buttons->addButton(tr("&Done"), QDialogButtonBox::AcceptRole);
    accept_->setDefault(true);
    buttons->addButton(tr("&Cancel"), QDialogButtonBox::RejectRole);
    connect(buttons, &QDialogButtonBox::accepted, this, &ChipForm::accept);
    connect(buttons, &QDialogButtonBox::rejected, this, &QDialog::reject);
    // Return in a text of several lines is a new line.
    const auto* shortcut = new QShortcut(QKeySequence(Qt::CTRL | Qt::Key_Return), this);
    connect(shortcut, &QShortcut::activated, this, &ChipForm::accept);
    for (QWidget* each : std::initializer_list<QWidget*>{line, value_, warning_, buttons}) layout()->addWidget(each);
}

std::u16string ChipForm::body() const {
    return isChanged_ ? editedBody(original_, *variable_) : original_;
}

void ChipForm::accept() {
    const std::u16string accepted = body();
    if (accepted.find(ClosingMarker) != std::u16string::npos) return;
    const Done done = std::move(done_);
    QDialog::accept();
    if (done) done(accepted);
}

void ChipForm::changed() {
    isChanged_ = true;
    showValue();
}

void ChipForm::showValue() {
    const Shown now = shown();
    const bool canBeWritten = body().find(ClosingMarker) == std::u16string::npos;
    const QString warning =
        canBeWritten ? now.warning
                     : tr("The sign %1 ends a placeholder and cannot stand in one.").arg(QChar(ClosingMarker));
    value_->setText(now.value);
    warning_->setText(warning.isEmpty() ? QString() : tr("⚠ %1").arg(warning));
    warning_->setVisible(!warning.isEmpty());
    if (accept_) accept_->setEnabled(canBeWritten);
}

void ChipForm::addOptionalRow() {
    auto* isOptional = new QCheckBox(tr("Can be &left out when the form is filled in"));
    auto* isTicked = new QCheckBox(tr("Is &ticked at first"));
    isOptional->setChecked(variable_->isOptional);
    isTicked->setChecked(variable_->isSelected);
    isTicked->setEnabled(variable_->isOptional);
    connect(isOptional, &QCheckBox::toggled, this, [this, isTicked](bool isOn) {
        variable_->isOptional = isOn;
        isTicked->setEnabled(isOn);
        changed();
    });
    connect(isTicked, &QCheckBox::toggled, this, [this](bool isOn) {
        variable_->isSelected = isOn;
        changed();
    });
    rows_->addRow(tr("Form:"), isOptional);
    rows_->addRow(QString(), isTicked);
}

void ChipForm::fitToRows() {
    if (!isVisible()) return;
    layout()->activate();
    resize(width(), sizeHint().height());
}

void ChipForm::placeAt(const QWidget& at) {
    const QRect place = services_.place.isNull() ? QRect(at.mapToGlobal(QPoint(0, 0)), at.size()) : services_.place;
    const QScreen* screen = QGuiApplication::screenAt(place.center());
    const QRect area = (screen ? screen : QGuiApplication::primaryScreen())->availableGeometry();
    const int width = std::max(WidthInLines * fontMetrics().height(), sizeHint().width());
    const int height = hasHeightForWidth() ? heightForWidth(width) : sizeHint().height();
    const QSize size = QSize(width, std::max(height, sizeHint().height())).boundedTo(area.size());
    resize(size);
    const bool fitsBelow = place.bottom() + size.height() <= area.bottom();
    const int top =
        fitsBelow || place.top() - size.height() < area.top() ? place.bottom() + 1 : place.top() - size.height();
    move(std::clamp(place.left(), area.left(), area.right() + 1 - size.width()),
         std::clamp(top, area.top(), area.bottom() + 1 - size.height()));
}

}  // namespace plume
