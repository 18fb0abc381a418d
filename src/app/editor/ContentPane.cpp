#include "app/editor/ContentPane.h"

#include <QAction>
#include <QStackedWidget>
#include <QToolBar>
#include <QVBoxLayout>
#include <utility>

#include "app/editor/ChipForm.h"
#include "app/editor/ContentEdit.h"
#include "app/editor/FormatBar.h"
#include "app/editor/InsertMenu.h"
#include "app/editor/ScriptEdit.h"

namespace plume {

ContentPane::ContentPane(ChipFormServices placeholders, ScriptRunServices scripts)
    : services_(std::move(placeholders)),
      text_(new ContentEdit),
      format_(new FormatBar(*text_)),
      script_(new ScriptEdit),
      stack_(new QStackedWidget),
      run_(new ScriptRunPanel(std::move(scripts))),
      scriptPage_(new QWidget),
      insert_(new QAction(tr("&Insert…"), this)),
      source_(new QAction(tr("Show So&urce"), this)) {
    auto* scriptLayout = new QVBoxLayout(scriptPage_);
    scriptLayout->setContentsMargins({});
    scriptLayout->addWidget(script_, 2);
    scriptLayout->addWidget(run_, 1);
    stack_->addWidget(text_);
    stack_->addWidget(scriptPage_);
    text_->setAccessibleName(tr("Content"));
    script_->setAccessibleName(tr("Script"));
    auto* layout = new QVBoxLayout(this);
    layout->setContentsMargins({});
    layout->setSpacing(0);
    makeBar();
    layout->addWidget(stack_, 1);
    setFocusProxy(text_);
    connect(text_, &ContentEdit::edited, this, &ContentPane::edited);
    connect(script_, &ScriptEdit::edited, this, &ContentPane::edited);
    connect(text_, &ContentEdit::openingTyped, this, &ContentPane::showInsertMenu);
    connect(text_, &ContentEdit::chipActivated, this, &ContentPane::changeChip);
}

void ContentPane::makeBar() {
    auto* bar = new QToolBar;
    bar->setToolButtonStyle(Qt::ToolButtonTextBesideIcon);
    insert_->setShortcut(QKeySequence(Qt::CTRL | Qt::Key_Space));
    insert_->setToolTip(tr("Insert a date, a field, another snippet… (Ctrl+Space, or type 【)"));
    connect(insert_, &QAction::triggered, this, &ContentPane::showInsertMenu);
    source_->setCheckable(true);
    source_->setShortcut(QKeySequence(Qt::CTRL | Qt::SHIFT | Qt::Key_U));
    source_->setToolTip(tr("Show placeholders as they are written (Ctrl+Shift+U)"));
    connect(source_, &QAction::toggled, text_, &ContentEdit::setShowsSource);
    bar->addAction(insert_);
    bar->addAction(source_);
    layout()->addWidget(bar);
    layout()->addWidget(format_);
}

bool ContentPane::isScript() const {
    return stack_->currentWidget() == scriptPage_;
}

void ContentPane::show(const std::shared_ptr<Snippet>& snippet) {
    const AttributedString content = snippet->richTextContent().value_or(AttributedString());
    const ContentType type = snippet->contentType();
    services_.inside = snippet;
    const bool isScript = type == ContentType::AppleScript || type == ContentType::ShellScript;
    stack_->setCurrentWidget(isScript ? scriptPage_ : static_cast<QWidget*>(text_));
    setFocusProxy(isScript ? static_cast<QWidget*>(script_) : text_);
    source_->setEnabled(!isScript);
    format_->setVisible(type == ContentType::RichText);
    run_->setScript(isScript ? snippet : nullptr, [this] { return script_->content().string(); });
    if (isScript) {
        script_->setAppleScript(type == ContentType::AppleScript);
        script_->setContent(content);
    } else {
        text_->setContent(content, type == ContentType::RichText);
    }
}

AttributedString ContentPane::content() const {
    return isScript() ? script_->content() : text_->content();
}

// ---- Placeholders ----

void ContentPane::showInsertMenu() {
    // One for each snippet, which is not offered to be put into itself.
    delete menu_;
    menu_ = new InsertMenu(placeholderServices(), focusProxy());
    connect(menu_, &InsertMenu::chosen, this, &ContentPane::insert);
    menu_->open(caretOnScreen().bottomLeft());
}

QRect ContentPane::caretOnScreen() const {
    const QRect caret = isScript() ? script_->cursorRect() : text_->cursorRect();
    const QWidget* area = isScript() ? script_->viewport() : text_->viewport();
    return {area->mapToGlobal(caret.topLeft()), caret.size()};
}

// Forms open at the caret.
ChipFormServices ContentPane::placeholderServices() const {
    ChipFormServices services = services_;
    services.place = caretOnScreen();
    return services;
}

void ContentPane::insert(const std::u16string& body) {
    isScript() ? script_->insertPlaceholder(body) : text_->insertPlaceholder(body);
}

void ContentPane::changeChip(const std::u16string& body) {
    ChipForm::open(text_, body, placeholderServices(),
                   [this](const std::u16string& changed) { text_->replaceActivatedChip(changed); });
}

}  // namespace plume
