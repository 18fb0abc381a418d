#include "app/editor/SnippetForm.h"

#include <QFormLayout>
#include <QKeyEvent>
#include <QLineEdit>
#include <QListView>
#include <QSignalBlocker>
#include <algorithm>
#include <utility>

#include "app/ContentPreview.h"
#include "app/FirstLine.h"
#include "app/editor/InsertModel.h"
#include "app/qt/Text.h"
#include "app/search/SnippetRowDelegate.h"

namespace plume {

namespace {

constexpr int RowsShown = 8;

}  // namespace

SnippetForm::SnippetForm(ChipFormServices services, std::shared_ptr<SnippetAbbreviationVariable> variable)
    : ChipForm(tr("Snippet"), std::move(services), variable),
      variable_(std::move(variable)),
      model_(new InsertModel(this)),
      query_(new QLineEdit),
      list_(new QListView) {
    query_->setPlaceholderText(tr("Abbreviation, label or text"));
    query_->setClearButtonEnabled(true);
    query_->installEventFilter(this);
    connect(query_, &QLineEdit::textChanged, this, &SnippetForm::search);
    rows().addRow(tr("&Search:"), query_);
    makeList();
    rows().addRow(tr("Snip&pet:"), list_);
    addOptionalRow();
    search();
}

void SnippetForm::makeList() {
    model_->setRows(snippetRows(services()));
    list_->setModel(model_);
    list_->setItemDelegate(new SnippetRowDelegate(list_));
    list_->setAccessibleName(tr("Snippets"));
    list_->setUniformItemSizes(true);
    list_->setHorizontalScrollBarPolicy(Qt::ScrollBarAlwaysOff);
    list_->setEditTriggers(QAbstractItemView::NoEditTriggers);
    list_->setMinimumHeight(RowsShown * std::max(list_->sizeHintForRow(0), fontMetrics().lineSpacing()));
    connect(list_->selectionModel(), &QItemSelectionModel::currentRowChanged, this, &SnippetForm::choose);
}

// What is named stays so until another row is chosen.
void SnippetForm::search() {
    const QSignalBlocker silent(list_->selectionModel());
    model_->search(query_->text());
    const auto snippet = named();
    const int row = snippet ? model_->rowOf(*snippet) : -1;
    list_->setCurrentIndex(row < 0 ? QModelIndex() : model_->index(row, 0));
    list_->viewport()->update();
    if (row >= 0) list_->scrollTo(list_->currentIndex());
}

void SnippetForm::choose(const QModelIndex& index) {
    const InsertRow* row = model_->rowAt(index.row());
    if (!row || row->snippet == named()) return;
    variable_->abbreviation = row->snippet->abbreviation().value_or(u"");
    variable_->uuid = row->snippet->uuid() ? std::optional(row->snippet->uuid()->toString()) : std::nullopt;
    changed();
}

bool SnippetForm::eventFilter(QObject* watched, QEvent* event) {
    if (watched != query_ || event->type() != QEvent::KeyPress) return ChipForm::eventFilter(watched, event);
    const int key = static_cast<const QKeyEvent*>(event)->key();
    if (key != Qt::Key_Down && key != Qt::Key_Up) return false;
    const int row = list_->currentIndex().row() + (key == Qt::Key_Down ? 1 : -1);
    list_->setCurrentIndex(model_->index(std::clamp(row, 0, std::max(0, model_->rowCount() - 1)), 0));
    return true;
}

std::shared_ptr<Snippet> SnippetForm::named() const {
    if (!services().groups) return nullptr;
    static const Snippet inNoGroup;
    const Snippet& around = services().inside ? *services().inside : inNoGroup;
    return findSnippetBySnippetAbbreviationVariable(*variable_, around, services().groups());
}

ChipForm::Shown SnippetForm::shown() const {
    const auto snippet = named();
    const bool isNone = variable_->abbreviation.value_or(u"").empty() && !variable_->uuid;
    if (!snippet && isNone) return {tr("Choose a snippet."), {}};
    if (!snippet) return {tr("Gives: nothing"), tr("The library has no snippet with this abbreviation.")};
    if (snippet == services().inside) return {tr("Gives: nothing"), tr("A snippet cannot stand in itself.")};
    const auto preview = previewOf(snippet, services().groups(), services().environment, services().environment.locale);
    if (preview && preview->isScript) return {tr("Runs the script and gives what it prints."), {}};
    return {preview ? tr("Gives: %1").arg(inOneLine(firstLine(preview->text()))) : tr("Gives: nothing"), {}};
}

}  // namespace plume
