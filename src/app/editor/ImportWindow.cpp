#include "app/editor/ImportWindow.h"

#include <QCheckBox>
#include <QCloseEvent>
#include <QDialogButtonBox>
#include <QHeaderView>
#include <QLabel>
#include <QListView>
#include <QPointer>
#include <QProgressBar>
#include <QPushButton>
#include <QShortcut>
#include <QStringListModel>
#include <QTreeView>
#include <QVBoxLayout>
#include <memory>
#include <utility>

#include "app/editor/ImportModel.h"
#include "app/qt/Labels.h"
#include "app/qt/Sentences.h"
#include "app/qt/Text.h"
#include "app/qt/WindowPlaces.h"

namespace plume {

namespace {

// Heights of a line.
constexpr int WindowWidth = 48;
constexpr int WindowHeight = 28;
constexpr int NameWidth = 12;
constexpr int RemarkWidth = 19;
constexpr int RemarksHeight = 6;

}  // namespace

ImportWindow::ImportWindow(QWidget* parent, Services services, const std::filesystem::path& path)
    : QDialog(parent),
      services_(std::move(services)),
      fileName_(QString::fromStdString(path.filename().string())),
      model_(new ImportModel(this)),
      remarkModel_(new QStringListModel(this)),
      heading_(makeSectionTitle({})),
      reason_(makeTextLabel()),
      progress_(new QProgressBar),
      list_(new QTreeView),
      converts_(new QCheckBox(tr("Convert the &placeholders of TextExpander"))),
      remarksTitle_(new QLabel(tr("What cannot be carried over &whole:"))),
      remarks_(new QListView) {
    setAttribute(Qt::WA_DeleteOnClose);
    setWindowTitle(tr("Import Snippets"));
    const auto* shortcut = new QShortcut(QKeySequence(Qt::CTRL | Qt::Key_W), this);
    connect(shortcut, &QShortcut::activated, this, &QWidget::close);
    makeList();
    makeRemarks();
    auto* layout = new QVBoxLayout(this);
    layout->addWidget(heading_);
    layout->addWidget(reason_);
    layout->addWidget(progress_);
    addShownWhenRead(*layout);
    makeButtons(*layout);
    const int line = fontMetrics().height();
    resize(WindowWidth * line, WindowHeight * line);
    rememberPlace(*this, services_.settings, "Import");
    read(path);
}

void ImportWindow::makeList() {
    list_->setModel(model_);
    list_->setUniformRowHeights(true);
    list_->setAllColumnsShowFocus(true);
    list_->setEditTriggers(QAbstractItemView::NoEditTriggers);
    list_->setAccessibleName(tr("Groups and snippets in the file"));
    QHeaderView* header = list_->header();
    header->setStretchLastSection(false);
    header->setSectionsMovable(false);
    header->setSectionResizeMode(ImportModel::ContentColumn, QHeaderView::Stretch);
    header->resizeSection(ImportModel::NameColumn, NameWidth * fontMetrics().height());
    header->resizeSection(ImportModel::RemarkColumn, RemarkWidth * fontMetrics().height());
    connect(model_, &ImportModel::dataChanged, this, &ImportWindow::showChoice);
}

void ImportWindow::makeRemarks() {
    remarks_->setModel(remarkModel_);
    remarks_->setEditTriggers(QAbstractItemView::NoEditTriggers);
    remarks_->setWordWrap(true);
    remarks_->setResizeMode(QListView::Adjust);
    remarks_->setTextElideMode(Qt::ElideNone);
    remarks_->setAccessibleName(tr("What cannot be carried over whole"));
    remarks_->setMaximumHeight(RemarksHeight * fontMetrics().lineSpacing());
    remarksTitle_->setBuddy(remarks_);
}

void ImportWindow::addShownWhenRead(QVBoxLayout& layout) {
    layout.addWidget(list_, 1);
    layout.addWidget(converts_);
    layout.addWidget(remarksTitle_);
    layout.addWidget(remarks_);
    // Keeps the rest at the edges while there is no list.
    layout.addStretch(0);
    for (QWidget* each : std::initializer_list<QWidget*>{reason_, list_, converts_, remarksTitle_, remarks_}) {
        each->hide();
    }
    progress_->setRange(0, 0);
    progress_->setTextVisible(false);
    progress_->setAccessibleName(tr("Reading"));
    connect(converts_, &QCheckBox::toggled, this, &ImportWindow::showPreview);
}

void ImportWindow::makeButtons(QVBoxLayout& layout) {
    auto* buttons = new QDialogButtonBox;
    importButton_ = buttons->addButton(tr("&Import"), QDialogButtonBox::AcceptRole);
    cancelButton_ = buttons->addButton(tr("Cancel"), QDialogButtonBox::RejectRole);
    importButton_->setDefault(true);
    importButton_->setEnabled(false);
    cancelButton_->setAutoDefault(false);
    connect(importButton_, &QPushButton::clicked, this, &ImportWindow::importChosen);
    connect(cancelButton_, &QPushButton::clicked, this, &QWidget::close);
    layout.addWidget(buttons);
}

// ---- Reading ----

void ImportWindow::read(const std::filesystem::path& path) {
    heading_->setText(tr("Reading “%1”…").arg(fileName_));
    const auto outcome = std::make_shared<Result<ImportCandidate>>(Error{});
    const Files& files = services_.files;
    const auto work = [outcome, &files, path] { *outcome = readForImport(path, files); };
    const auto done = [self = QPointer(this), outcome] {
        if (self) self->showRead(std::move(*outcome));
    };
    if (services_.inBackground) return services_.inBackground(work, done);
    work();
    done();
}

void ImportWindow::showRead(Result<ImportCandidate> candidate) {
    progress_->hide();
    if (!candidate) {
        return showFailure(tr("Nothing can be imported from “%1”").arg(fileName_),
                           breakable(inUsersLanguage(candidate.error().message)));
    }
    candidate_ = std::move(candidate).value();
    if (candidate_.library.groups.empty()) {
        return showFailure(tr("There are no snippets in “%1”").arg(fileName_), {});
    }
    list_->show();
    converts_->setVisible(candidate_.converted.has_value());
    showPreview();
    list_->setCurrentIndex(model_->index(0, 0));
    list_->setFocus();
}

void ImportWindow::showFailure(const QString& heading, const QString& reason) {
    heading_->setText(heading);
    reason_->setText(reason);
    reason_->setVisible(!reason.isEmpty());
    importButton_->hide();
    cancelButton_->setText(tr("Close"));
    cancelButton_->setFocus();
}

// ---- What is in it ----

void ImportWindow::showPreview() {
    const bool isConverted = converts_->isChecked() && candidate_.converted;
    model_->show(importPreview(isConverted ? *candidate_.converted : candidate_.library, services_.library()));
    if (model_->rowCount() == 1) list_->expand(model_->index(0, 0));
    QStringList remarks;
    for (const std::string& remark : model_->preview().remarks) remarks += inUsersLanguage(remark);
    remarkModel_->setStringList(remarks);
    remarksTitle_->setVisible(!remarks.isEmpty());
    remarks_->setVisible(!remarks.isEmpty());
    showHeading();
    showChoice();
}

void ImportWindow::showHeading() {
    const auto groups = static_cast<int>(model_->preview().groups.size());
    const auto snippets = static_cast<int>(model_->preview().snippetCount());
    const QString inGroups = groups == 1 ? tr("in 1 group") : tr("in %n groups", "", groups);
    const QString count = snippets == 1 ? tr("1 snippet") : tr("%n snippets", "", snippets);
    //: The file's name, "12 snippets", "in 2 groups".
    heading_->setText(tr("“%1”: %2 %3").arg(fileName_, count, inGroups));
}

void ImportWindow::showChoice() {
    const std::size_t count = model_->chosenCount();
    importButton_->setEnabled(count > 0);
    if (count == 0) return importButton_->setText(tr("&Import"));
    importButton_->setText(count == 1 ? tr("&Import 1 Group") : tr("&Import %n Groups", "", static_cast<int>(count)));
}

void ImportWindow::importChosen() {
    ImportedLibrary chosen;
    chosen.groups = model_->chosenGroups();
    chosen.remarks = model_->preview().remarks;
    if (chosen.groups.empty()) return;
    services_.import(chosen);
    close();
}

void ImportWindow::closeEvent(QCloseEvent* event) {
    event->accept();
}

}  // namespace plume
