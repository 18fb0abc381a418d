#include "app/windows/QtWindows.h"

#include <QApplication>
#include <algorithm>
#include <utility>

#include "app/qt/Messages.h"
#include "app/qt/Sentences.h"
#include "app/qt/Text.h"
#include "app/windows/AboutWindow.h"
#include "app/windows/DiagnosticWindow.h"
#include "app/windows/FilePanels.h"
#include "app/windows/FileUseQuestion.h"
#include "app/windows/FirstSyncWindow.h"
#include "app/windows/NewSnippetWindow.h"
#include "app/windows/PromptWindow.h"
#include "app/windows/ReportsWindow.h"
#include "app/windows/RestoreWindow.h"
#include "app/windows/WelcomeWindow.h"

namespace plume {

namespace {

// Menus and tool tips are none.
bool isOpenWindow(const QWidget* window) {
    const Qt::WindowType type = window->windowType();
    return window->isVisible() && (type == Qt::Window || type == Qt::Dialog);
}

}  // namespace

QtWindows::QtWindows(Dependencies dependencies) : around_(std::move(dependencies)) {}

QtWindows::~QtWindows() {
    for (const auto& window : opened_) delete window.data();
}

void QtWindows::own(QWidget* window) {
    std::erase_if(opened_, [](const auto& each) { return each.isNull(); });
    opened_.emplace_back(window);
}

template <typename Window, typename Make>
Window& QtWindows::theOnly(QPointer<Window>& window, const Make& make) {
    // A closed one lives on until the event loop has its turn.
    if (!window || window->isHidden()) {
        window = make();
        own(window);
    }
    return *window;
}

// ---- Windows of which there is one ----

void QtWindows::showAboutWindow() {
    bringToFront(theOnly(about_, [this] { return new AboutWindow(around_.version, around_.settings); }));
}

void QtWindows::showDiagnosticWindow(const std::u16string& report) {
    const QString text = toQString(report);
    DiagnosticWindow& window = theOnly(diagnostics_, [&] { return new DiagnosticWindow(text); });
    window.setReport(text);
    window.showCentred();
}

void QtWindows::showReportsWindow() {
    bringToFront(theOnly(reports_, [this] { return new ReportsWindow(around_.reports, around_.settings); }));
}

void QtWindows::showWelcomeWindow() {
    bringToFront(theOnly(welcome_, [this] { return new WelcomeWindow(around_.welcome(), around_.settings); }));
}

void QtWindows::showRestoreWindow() {
    bringToFront(theOnly(restore_, [this] {
        return new RestoreDataWindowController(around_.dataManager, around_.files, around_.settings);
    }));
}

void QtWindows::showNewSnippetWindow(const std::u16string& content) {
    if (!content.empty()) newSnippet_ = nullptr;
    bringToFront(
        theOnly(newSnippet_, [&] { return new NewSnippetWindow(around_.dataManager, content, around_.settings); }));
}

// ---- Questions and messages ----

void QtWindows::showPrompt(const Error& missing, std::function<Result<void>()> checkAgain,
                           std::function<void()> closed) {
    auto* window = new PromptWindow(missing, std::move(checkAgain), std::move(closed));
    own(window);
    bringToFront(*window);
}

void QtWindows::askForFileUse(const Path& file, std::function<void(FileUse)> answer) {
    own(plume::askForFileUse(file, std::move(answer)));
}

void QtWindows::askForFile(std::function<void(const Path&)> chosen) {
    own(askForLibraryFile(std::move(chosen)));
}

void QtWindows::askWhereToExport(std::function<void(const Path&)> chosen) {
    own(plume::askWhereToExport(std::move(chosen)));
}

void QtWindows::askForFirstSync(const std::string& folderName, std::function<void(int)> answer) {
    auto* window = new InitalSyncWindowController(folderName, std::move(answer));
    own(window);
    bringToFront(*window);
}

void QtWindows::tell(const std::u16string& message, const std::u16string& details) {
    own(plume::tell(nullptr, inUsersLanguage(toQString(message)), inUsersLanguage(toQString(details))));
}

bool QtWindows::hasVisibleWindow() const {
    const QWidgetList all = QApplication::topLevelWidgets();
    return std::any_of(all.begin(), all.end(), isOpenWindow);
}

void QtWindows::bringAllToFront() {
    const QWidgetList all = QApplication::topLevelWidgets();
    for (QWidget* window : all) {
        if (isOpenWindow(window)) bringToFront(*window);
    }
    // Nothing else takes keys before it is answered.
    if (QWidget* question = QApplication::activeModalWidget()) bringToFront(*question);
}

}  // namespace plume
