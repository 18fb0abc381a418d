#include "app/cli/RunCommand.h"

#include <sys/signalfd.h>

#include <atomic>
#include <csignal>
#include <filesystem>
#include <memory>
#include <mutex>
#include <ostream>
#include <thread>
#include <utility>

#include "app/Composition.h"
#include "app/cli/CommandLine.h"
#include "app/cli/Files.h"
#include "app/cli/InstanceLock.h"
#include "app/cli/RunSources.h"
#include "app/linux/LinuxApplications.h"
#include "app/linux/LinuxPort.h"
#include "app/linux/PasswordFieldConsent.h"
#include "library/MemoryUserDefaults.h"
#include "library/SettingsFile.h"

namespace plume {

namespace {

// Null when none is named.
Result<std::unique_ptr<FollowedLibrary>> openFile(const std::optional<std::string>& named, const Files& files) {
    if (!named) return std::unique_ptr<FollowedLibrary>();
    return FollowedLibrary::open(std::filesystem::absolute(*named), files);
}

// Null when none are named.
Result<std::shared_ptr<const UserDefaults>> readSettings(const std::optional<std::string>& named) {
    if (!named) return std::shared_ptr<const UserDefaults>();
    const Result<std::string> text = readWholeFile(*named);
    if (!text) return text.error();
    return SettingsFile::read(text.value(), *named);
}

// Writes sentences for the user, from any thread.
class Voice {
  public:
    explicit Voice(std::ostream& stream) : stream_(stream) {}
    void say(const std::string& sentence) {
        const std::lock_guard lock(mutex_);
        stream_ << "plume: " << sentence << std::endl;
    }

  private:
    std::mutex mutex_;
    std::ostream& stream_;
};

// The signals that end the program, as a descriptor. Made before other threads are, so that none of them gets one.
FileDescriptor endSignals() {
    sigset_t signals;
    sigemptyset(&signals);
    for (const int number : {SIGINT, SIGTERM, SIGHUP}) sigaddset(&signals, number);
    pthread_sigmask(SIG_BLOCK, &signals, nullptr);
    // A program that went away while it was written to is no reason to end.
    (void)std::signal(SIGPIPE, SIG_IGN);
    return FileDescriptor(signalfd(-1, &signals, SFD_CLOEXEC | SFD_NONBLOCK));
}

class Run {
  public:
    Run(LinuxPort& port, RunSources& sources, std::ostream& output, Voice& voice)
        : port_(port), sources_(sources), output_(output), voice_(voice) {}

    int untilAskedToEnd(int signals) {
        const Subscription source = port_.mainLoop().addSource(signals, [this, signals] {
            signalfd_siginfo signal{};
            if (read(signals, &signal, sizeof signal) == sizeof signal) end(ExitStatus::Success);
        });
        port_.setCannotShowNotice([this](const std::string& body) { voice_.say(body); });
        port_.setServerGone([this] {
            voice_.say("The X server is gone.");
            end(ExitStatus::Failure);
        });
        PasswordFieldConsent consent(
            {port_.accessibility(), port_.ports().notices, port_.mainLoop(), sources_.userDefaults(),
             [this](const std::string& sentence) { voice_.say(sentence); }, sources_.writableSettings()});
        consent.begin();
        const std::string description = sources_.description();
        std::thread tapThread([this, description, update = libraryUpdate(), settings = sources_.settings()] {
            settings_.registerDefaults(settings);
            if (update) library_.apply(*update);
            expand(description);
        });
        port_.mainLoop().run();
        port_.tapLoop().stop();
        tapThread.join();
        return status_;
    }

  private:
    void end(int status) {
        status_ = status;
        port_.mainLoop().stop();
    }

    // The tap thread.
    void expand(const std::string& description) {
        {
            Composition composition(port_.ports(), environment());
            composition.setSnippetGroups(library_.groups());
            composition.loadPreferences();
            MacInputService& service = composition.inputService();
            port_.mainLoop().perform([this, &service] {
                service_ = &service;
                keyboardGivenUp_ = service.keyboardTapGivenUpEvent.addObserver(this, &Run::keyboardLost);
            });
            port_.mainLoop().perform([this, &composition] { feed(composition); });
            composition.start();
            // What happens to the keyboard during a sleep, nobody hears.
            port_.setSleepListener([this, &composition](bool sleeps) {
                port_.tapLoop().perform([&composition] { composition.engine().clear(); });
                sleeps ? composition.stop() : composition.inputService().enableEvents();
            });
            // After the start, which waits in the loop, too.
            port_.tapLoop().perform([this, &service, &description] { tellWhetherStarted(service, description); });
            port_.tapLoop().run();
        }
        port_.leave();
    }

    // The main thread, from which what changes goes to the tap thread as records of its own.
    void feed(Composition& composition) {
        sources_.begin(
            [this, &composition] {
                auto update = libraryUpdate();
                if (!update) return;
                port_.tapLoop().perform([this, &composition, update = std::move(update)]() mutable {
                    library_.apply(*update);
                    composition.setSnippetGroups(library_.groups());
                    // What went out is freed where nobody waits for a key.
                    port_.mainLoop().perform([freed = std::move(update)] {});
                });
            },
            [this, &composition] {
                port_.tapLoop().perform([this, &composition, settings = sources_.settings()] {
                    settings_.registerDefaults(settings);
                    composition.loadPreferences();
                });
            });
    }

    std::shared_ptr<LibraryUpdate> libraryUpdate() {
        auto update = sources_.libraryUpdate();
        return update ? std::make_shared<LibraryUpdate>(*std::move(update)) : nullptr;
    }

    void tellWhetherStarted(const MacInputService& service, const std::string& description) {
        // What is missing was told already.
        if (!service.evenTapCreated()) return end(ExitStatus::MissingSystem);
        output_ << "Plume is ready: " << description << ". Ctrl+C ends it." << std::endl;
    }

    Composition::Environment environment() {
        const auto say = [this](const std::string& sentence) { voice_.say(sentence); };
        return {.settings = settings_,
                .report = say,
                .log = say,
                .timeZone = {},
                .locale = {},
                .makeFieldsEditor = {},
                .makeSuggestionController = {},
                .makeQuickSearchController = {},
                .suggest = {},
                .vmHelper = nullptr,
                .applications = applications(),
                .enabledChanged = [this](bool enabled) {
                    port_.mainLoop().perform([this, enabled] { keepEnabled(enabled); });
                }};
    }

    // Or the next change of any setting would undo what the hot key did.
    void keepEnabled(bool enabled) {
        WritableUserDefaults* settings = sources_.writableSettings();
        if (!settings) return;
        if (const auto kept = settings->setObject("IsEnabled", enabled); !kept) voice_.say(kept.error().message);
    }

    std::shared_ptr<const ApplicationTable> applications() {
        const auto file = dataFolder() / "applications.json";
        const LinuxApplications read = readLinuxApplications(readWholeFile(file), file.string());
        if (read.problem) {
            voice_.say(read.problem->message);
            voice_.say("In place of that file, the table of applications counts that Plume was built with.");
        }
        return read.table;
    }

    void keyboardLost(KeyboardTapGivenUp& /*event*/) {
        const auto listenAgain = [this] { port_.tapLoop().perform([this] { service_->tryTapAgain(); }); };
        port_.ports().notices.show({"Plume does not listen",
                                    "Listening to the keyboard was ended three times within a minute, because Plume "
                                    "did not answer in time. It is tried again in a minute.",
                                    {{"Listen now", listenAgain}}});
    }

    LinuxPort& port_;
    RunSources& sources_;          // of the main thread
    MemoryUserDefaults settings_;  // of the tap thread
    FedLibrary library_;           // of the tap thread
    std::ostream& output_;
    Voice& voice_;
    std::atomic<int> status_ = ExitStatus::Success;
    MacInputService* service_ = nullptr;  // of the tap thread, as long as its loop runs
    Subscription keyboardGivenUp_;        // of the main thread, like the event
};

}  // namespace

int runInSession(const std::optional<std::string>& libraryFile, const std::optional<std::string>& settingsFile,
                 std::ostream& output, std::ostream& error) {
    Voice voice(error);
    const auto refuse = [&voice](const Error& reason, int status) {
        voice.say(reason.message);
        return status;
    };
    PosixFiles files;
    const auto file = openFile(libraryFile, files);
    if (!file) return refuse(file.error(), ExitStatus::WrongInput);
    const auto settings = readSettings(settingsFile);
    if (!settings) return refuse(settings.error(), ExitStatus::WrongInput);

    const FileDescriptor signals = endSignals();
    const auto port = LinuxPort::open({}, soundFolder());
    if (!port) return refuse(port.error(), ExitStatus::MissingSystem);
    const Result<InstanceLock> lock = InstanceLock::take({});
    if (!lock) return refuse(lock.error(), ExitStatus::Failure);
    const auto sources =
        RunSources::open({file.value().get(), settings.value(), port.value()->mainLoop(), port.value()->ports().notices,
                          [&voice](const std::string& sentence) { voice.say(sentence); }});
    if (!sources) return refuse(sources.error(), ExitStatus::Failure);
    if (const auto watched = port.value()->startWatchdog(); !watched) {
        return refuse(watched.error(), ExitStatus::MissingSystem);
    }
    return Run(*port.value(), *sources.value(), output, voice).untilAskedToEnd(signals.get());
}

}  // namespace plume
