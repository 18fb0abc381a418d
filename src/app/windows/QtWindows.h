// The windows of the application.
//
// Owned by whoever puts the application together; belongs to the main thread. All that is referred to outlives it, and
// windows that are open when it goes are closed without further answers.
#pragma once

#include <QPointer>
#include <QString>
#include <QWidget>
#include <vector>

#include "app/ApplicationWindows.h"
#include "app/ReportLog.h"
#include "app/windows/WelcomeServices.h"
#include "library/DataManager.h"

namespace plume {

class AboutWindow;
class DiagnosticWindow;
class NewSnippetWindow;
class ReportsWindow;
class RestoreDataWindowController;
class WelcomeWindow;

class QtWindows final : public ApplicationWindows {
  public:
    struct Dependencies {
        WritableUserDefaults& settings;
        DataManager& dataManager;
        const Files& files;
        ReportLog& reports;
        QString version;
        // Asked for whenever the welcome is shown.
        std::function<WelcomeServices()> welcome;
        // The windows of other folders.
        std::function<void(bool expandAll)> showMacros;
        std::function<void(const std::shared_ptr<Snippet>&)> showSnippet;
        std::function<void(const std::string& page)> showPreferences;
        std::function<void()> showDecisions;
        // Puts what is edited in them into the library.
        std::function<void()> commitEdits;
    };

    explicit QtWindows(Dependencies dependencies);
    ~QtWindows() override;
    QtWindows(const QtWindows&) = delete;
    QtWindows& operator=(const QtWindows&) = delete;

    void showMacrosWindow(bool expandAll) override { around_.showMacros(expandAll); }
    void showSnippet(const std::shared_ptr<Snippet>& snippet) override { around_.showSnippet(snippet); }
    // Text to begin with has a window of its own; what is edited in another one stays.
    void showNewSnippetWindow(const std::u16string& content) override;
    void showPreferencesWindow(const std::string& page) override { around_.showPreferences(page); }
    void showAboutWindow() override;
    void showDiagnosticWindow(const std::u16string& report) override;
    void showReportsWindow() override;
    void showDecisionsWindow() override { around_.showDecisions(); }
    void showWelcomeWindow() override;
    void showRestoreWindow() override;
    void showPrompt(const Error& missing, std::function<Result<void>()> checkAgain,
                    std::function<void()> closed) override;
    void askForFileUse(const Path& file, std::function<void(FileUse)> answer) override;
    void askForFile(std::function<void(const Path&)> chosen) override;
    void askWhereToExport(std::function<void(const Path&)> chosen) override;
    void askForFirstSync(const std::string& folderName, std::function<void(int returnCode)> answer) override;
    void tell(const std::u16string& message, const std::u16string& details) override;

    bool hasVisibleWindow() const override;
    void bringAllToFront() override;
    void commitEdits() override { around_.commitEdits(); }

  private:
    template <typename Window, typename Make>
    Window& theOnly(QPointer<Window>& window, const Make& make);
    void own(QWidget* window);

    const Dependencies around_;
    QPointer<AboutWindow> about_;
    QPointer<DiagnosticWindow> diagnostics_;
    QPointer<NewSnippetWindow> newSnippet_;  // the latest one
    QPointer<ReportsWindow> reports_;
    QPointer<RestoreDataWindowController> restore_;
    QPointer<WelcomeWindow> welcome_;
    std::vector<QPointer<QWidget>> opened_;  // all of them, and questions, panels and messages
};

}  // namespace plume
