#include "app/cli/Application.h"

#include <sys/signalfd.h>

#include <QApplication>
#include <QMessageBox>
#include <QPointer>
#include <QSessionManager>
#include <algorithm>
#include <cstdlib>
#include <filesystem>
#include <memory>
#include <optional>
#include <ostream>
#include <string>
#include <thread>
#include <utility>

#include "Foundation/Strings.h"
#include "app/AppDelegate.h"
#include "app/cli/ApplicationCommands.h"
#include "app/cli/ApplicationServices.h"
#include "app/cli/BackgroundWork.h"
#include "app/cli/CommandLine.h"
#include "app/cli/Files.h"
#include "app/cli/InstanceLock.h"
#include "app/cli/Session.h"
#include "app/cli/UserLibrary.h"
#include "app/cli/Version.h"
#include "app/cli/Voice.h"
#include "app/editor/MacrosWindowController.h"
#include "app/form/FormWindows.h"
#include "app/linux/LinuxPort.h"
#include "app/linux/PasswordFieldConsent.h"
#include "app/preferences/PreferencesWindow.h"
#include "app/qt/ColorScheme.h"
#include "app/qt/QtRunLoop.h"
#include "app/qt/Sentences.h"
#include "app/qt/Translations.h"
#include "app/search/QuickSearchWindow.h"
#include "app/search/SuggestionWindow.h"
#include "app/session/SessionService.h"
#include "app/status/StatusIcons.h"
#include "app/status/TrayIcon.h"
#include "app/windows/DecisionsWindow.h"
#include "app/windows/PromptWindow.h"
#include "app/windows/QtWindows.h"
#include "app/windows/SmallWindow.h"
#include "ports/x11/XcbConnection.h"

namespace plume {

namespace {

class Application {
    Q_DECLARE_TR_FUNCTIONS(Application)
  public:
    Application(QtRunLoop& loop, LinuxPort& port, Voice& voice)
        : loop_(loop), port_(port), voice_(voice), background_(loop) {}

    // The error says why there are no settings, and so no library.
    Result<void> open();
    int run(int signals);

  private:
    Result<std::unique_ptr<UserLibrary>> openSettings();
    QtWindows::Dependencies windowsDependencies();
    AppDelegate::Dependencies delegateDependencies();
    void openSession();
    void begin();
    void end(int status);
    void showPreferences(const std::string& page);
    void showDecisions();
    MacrosWindowController& showEditor(bool expandAll);
    SuggestionView& suggestionView();
    QuickSearchView& quickSearchView();
    FormView& formView();

    QtRunLoop& loop_;
    LinuxPort& port_;
    Voice& voice_;
    PosixFiles files_;
    BackgroundWork background_;
    std::unique_ptr<UserLibrary> library_;
    std::unique_ptr<SnippetUses> uses_;
    ReportLog reports_;
    std::unique_ptr<QtWindows> windows_;
    std::unique_ptr<SuggestionWindow> suggestions_;
    std::unique_ptr<QuickSearchWindow> quickSearch_;
    std::unique_ptr<FormWindows> forms_;
    std::unique_ptr<AppDelegate> delegate_;
    std::unique_ptr<ApplicationServices> services_;
    std::unique_ptr<ApplicationCommands> commands_;
    std::unique_ptr<PasswordFieldConsent> consent_;
    std::unique_ptr<CommandSocket> socket_;
    std::unique_ptr<SessionService> service_;
    QPointer<PreferencesWindow> preferences_;
    QPointer<DecisionsWindow> decisions_;
    QPointer<MacrosWindowController> editor_;
    int status_ = ExitStatus::Success;
};

Result<void> Application::open() {
    auto library = openSettings();
    if (!library) return library.error();
    library_ = std::move(library).value();
    uses_ = std::make_unique<SnippetUses>(library_->settings());
    windows_ = std::make_unique<QtWindows>(windowsDependencies());
    delegate_ = std::make_unique<AppDelegate>(delegateDependencies());
    services_ = std::make_unique<ApplicationServices>(
        ApplicationServices::Dependencies{*delegate_, *library_, *uses_, files_, port_.ports().sounds, loop_});
    commands_ = std::make_unique<ApplicationCommands>(*delegate_, library_->manager(), files_);
    return {};
}

Result<std::unique_ptr<UserLibrary>> Application::openSettings() {
    return UserLibrary::openSettings({
        .loop = loop_,
        .report =
            [this](const std::string& sentence) { delegate_ ? delegate_->report(sentence) : voice_.say(sentence); },
        .inBackground = [this](std::function<void()> work,
                               std::function<void()> done) { background_.begin(std::move(work), std::move(done)); },
        .loadPreferences = [this] { delegate_->loadPreferences(); },
        .offerBackup = [this](const std::optional<Files::Path>& newest) { delegate_->offerBackup(newest); },
        .askFirst = [this](const std::string& folderName) { delegate_->askFirst(folderName); },
    });
}

QtWindows::Dependencies Application::windowsDependencies() {
    return {.settings = library_->settings(),
            .dataManager = library_->manager(),
            .files = files_,
            .reports = reports_,
            .version = Version,
            .welcome = [this] { return services_->welcome(); },
            .showMacros = [this](bool expandAll) { showEditor(expandAll); },
            .showSnippet = [this](const std::shared_ptr<Snippet>& snippet) { showEditor(false).edit(snippet); },
            .showPreferences = [this](const std::string& page) { showPreferences(page); },
            .showDecisions = [this] { showDecisions(); },
            .commitEdits =
                [this] {
                    if (editor_) editor_->commitEdits();
                }};
}

AppDelegate::Dependencies Application::delegateDependencies() {
    return {.mainLoop = loop_,
            .settings = library_->settings(),
            .dataManager = library_->manager(),
            .windows = *windows_,
            .reports = reports_,
            .suggestionView = [this]() -> SuggestionView& { return suggestionView(); },
            .quickSearchView = [this]() -> QuickSearchView& { return quickSearchView(); },
            .formView = [this]() -> FormView& { return formView(); },
            .uses = *uses_,
            .ports = port_.ports(),
            .applications = installedApplications(voice_),
            .log = [this](const std::string& line) { voice_.say(line); },
            .makeStatusItem = [this]() -> std::unique_ptr<StatusItem> {
                return std::make_unique<TrayIcon>(services_->statusMenu());
            },
            .terminate = [this] { end(ExitStatus::Success); },
            .version = Version,
            .systemVersion = systemVersion()};
}

void Application::showPreferences(const std::string& page) {
    if (!preferences_ || preferences_->isHidden()) preferences_ = new PreferencesWindow(services_->preferences());
    preferences_->showPage(page);
    bringToFront(*preferences_);
}

void Application::showDecisions() {
    if (!decisions_ || decisions_->isHidden())
        decisions_ = new DecisionsWindow(services_->decisions(), library_->settings());
    bringToFront(*decisions_);
}

// A window that is open already stays as the user has it.
MacrosWindowController& Application::showEditor(bool expandAll) {
    if (!editor_ || editor_->isHidden()) {
        EditorServices services = services_->editor();
        services.askForFile = [this](auto chosen) { windows_->askForFile(std::move(chosen)); };
        editor_ = new MacrosWindowController(std::move(services));
        if (expandAll) editor_->openAllGroups();
    }
    bringToFront(*editor_);
    return *editor_;
}

// Made when they are first needed: most of the time there is neither.
SuggestionView& Application::suggestionView() {
    if (!suggestions_) suggestions_ = std::make_unique<SuggestionWindow>();
    return *suggestions_;
}

QuickSearchView& Application::quickSearchView() {
    if (!quickSearch_) quickSearch_ = std::make_unique<QuickSearchWindow>(services_->quickSearch());
    return *quickSearch_;
}

FormView& Application::formView() {
    if (!forms_) {
        forms_ = std::make_unique<FormWindows>(
            FormWindows::Services{.mainLoop = loop_,
                                  .settings = library_->settings(),
                                  .program = programFolder() / "plume-form",
                                  .programRuns = [this](std::int64_t process) { port_.setFormProcess(process); },
                                  .report = [this](const std::string& sentence) { delegate_->report(sentence); }});
    }
    return *forms_;
}

// Reachable before everything is there: whoever calls early is told so.
void Application::openSession() {
    const auto path = InstanceLock::socketPathFor({});
    auto opened =
        path ? CommandSocket::open(path.value(), loop_,
                                   [this](const CommandRequest& request) { return commands_->perform(request); })
             : Result<std::unique_ptr<CommandSocket>>(path.error());
    if (opened) {
        socket_ = std::move(opened).value();
    } else {
        voice_.say(opened.error().message);
    }
    service_ = std::make_unique<SessionService>([this](const std::vector<std::string>& words) {
        return commands_->perform({"/", words});
    });
}

void Application::begin() {
    port_.setCannotShowNotice([this](const std::string& body) { voice_.say(body); });
    port_.setNoticeWords([](const std::string& text) { return inUsersLanguage(text).toStdString(); });
    port_.setServerGone([this] {
        loop_.perform([this] {
            voice_.say("The X server is gone.");
            end(ExitStatus::Failure);
        });
    });
    port_.setKeyboardHeldByUs([] { return QApplication::activePopupWidget() != nullptr; });
    port_.setSleepListener(
        [this](bool sleeps) { sleeps ? delegate_->workspaceWillSleep() : delegate_->workspaceDidWake(); });
    // Whoever wants it at every login says so in the preferences; a session that started it, too, would have it show a
    // window each time.
    QObject::connect(qApp, &QGuiApplication::saveStateRequest, qApp,
                     [](QSessionManager& session) { session.setRestartHint(QSessionManager::RestartNever); });
    // The session goes on until it says otherwise; what was changed is kept whatever comes.
    QObject::connect(qApp, &QGuiApplication::commitDataRequest, qApp, [this](QSessionManager&) {
        windows_->commitEdits();
        if (const auto saved = library_->manager().saveRest(); !saved) voice_.say(saved.error().message);
    });
    consent_ = std::make_unique<PasswordFieldConsent>(PasswordFieldConsent::Dependencies{
        port_.accessibility(), port_.ports().notices, loop_, library_->settings(),
        [this](const std::string& sentence) { delegate_->report(sentence); }, &library_->settings()});
    consent_->begin();
    delegate_->applicationDidFinishLaunching([this] { return library_->load(); });
}

int Application::run(int signals) {
    const Subscription source = loop_.addSource(signals, [this, signals] {
        signalfd_siginfo signal{};
        while (read(signals, &signal, sizeof signal) == sizeof signal) end(ExitStatus::Success);
    });
    openSession();
    begin();
    std::thread tapThread([this] {
        port_.tapLoop().run();
        port_.leave();
    });
    QApplication::exec();
    // Nobody is answered any more, nothing is heard, everything is kept.
    service_ = nullptr;
    socket_ = nullptr;
    delegate_->applicationWillTerminate();
    port_.tapLoop().perform([this] { port_.tapLoop().stop(); });
    tapThread.join();
    background_.finish();
    delete preferences_;
    delete decisions_;
    delete editor_;
    quickSearch_ = nullptr;
    forms_ = nullptr;
    suggestions_ = nullptr;
    windows_ = nullptr;
    return status_;
}

void Application::end(int status) {
    status_ = status;
    QApplication::quit();
}

// Null when the user gives up before the desktop has what Plume needs.
std::unique_ptr<LinuxPort> openPort(QtRunLoop& loop) {
    std::unique_ptr<LinuxPort> port;
    const auto open = [&loop, &port]() -> Result<void> {
        auto opened = LinuxPort::open(loop, {}, soundFolder());
        if (!opened) return opened.error();
        port = std::move(opened).value();
        return port->startWatchdog();
    };
    const Result<void> opened = open();
    if (opened) return port;
    auto* const prompt = new PromptWindow(opened.error(), open, [] { QApplication::quit(); });
    prompt->show();
    QApplication::exec();
    return port;
}

// The window server is asked before Qt is, which would end the program in its own words.
bool displayIsThere(Voice& voice) {
    const char* const display = std::getenv("DISPLAY");
    if (!display || !*display) {
        voice.say("There is no X display: DISPLAY is not set. Start Plume in a graphical session.");
        return false;
    }
    const auto connection = XcbConnection::open({});
    if (!connection) voice.say(connection.error().message);
    return connection.ok();
}

int refuseSecondInstance(const Error& why, Voice& voice) {
    voice.say(why.message);
    QMessageBox alert(QMessageBox::Warning, "Plume",
                      Application::tr("There is already one or more instance(s) of Plume running."), QMessageBox::Ok);
    alert.setInformativeText(Application::tr("This instance will exit and bring other instances to front."));
    alert.exec();
    return ExitStatus::Failure;
}

}  // namespace

int runApplication(int argc, char** argv, std::ostream& error) {
    Voice voice(error);
    const FileDescriptor signals = endSignals();
    if (!displayIsThere(voice)) return ExitStatus::MissingSystem;
    // The windows are where the keyboard is heard.
    if (!std::getenv("QT_QPA_PLATFORM")) setenv("QT_QPA_PLATFORM", "xcb", 1);
    QApplication application(argc, argv);
    QApplication::setApplicationName("plume");
    QApplication::setApplicationDisplayName("Plume");
    QApplication::setDesktopFileName("org.plume.Plume");
    QApplication::setQuitOnLastWindowClosed(false);
    installTranslations(application, translationFolder());
    QApplication::setWindowIcon(applicationIcon());
    const auto colorScheme = followColorScheme();
    QtRunLoop loop;
    const Result<InstanceLock> lock = InstanceLock::take({});
    if (!lock) return refuseSecondInstance(lock.error(), voice);
    const std::unique_ptr<LinuxPort> port = openPort(loop);
    if (!port) return ExitStatus::MissingSystem;
    Application plume(loop, *port, voice);
    if (const auto opened = plume.open(); !opened) {
        voice.say(opened.error().message);
        return ExitStatus::Failure;
    }
    return plume.run(signals.get());
}

}  // namespace plume
