#include "app/cli/RunCommand.h"

#include <sys/signalfd.h>

#include <atomic>
#include <filesystem>
#include <memory>
#include <ostream>
#include <thread>
#include <utility>

#include "app/Expansion.h"
#include "app/cli/CommandLine.h"
#include "app/cli/Files.h"
#include "app/cli/InstanceLock.h"
#include "app/cli/RunSources.h"
#include "app/cli/Session.h"
#include "app/cli/Voice.h"
#include "app/linux/LinuxPort.h"
#include "app/linux/PasswordFieldConsent.h"
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

class Run final : private ExpansionListener {
  public:
    Run(PollRunLoop& loop, LinuxPort& port, RunSources& sources, std::ostream& output, Voice& voice)
        : loop_(loop),
          port_(port),
          sources_(sources),
          output_(output),
          voice_(voice),
          expansion_({.ports = port.ports(),
                      .applications = installedApplications(voice),
                      .log = [&voice](const std::string& line) { voice.say(line); },
                      .listener = *this}) {}

    int untilAskedToEnd(int signals) {
        const Subscription source = loop_.addSource(signals, [this, signals] {
            signalfd_siginfo signal{};
            if (read(signals, &signal, sizeof signal) == sizeof signal) end(ExitStatus::Success);
        });
        port_.setCannotShowNotice([this](const std::string& body) { voice_.say(body); });
        port_.setServerGone([this] {
            voice_.say("The X server is gone.");
            end(ExitStatus::Failure);
        });
        PasswordFieldConsent consent({port_.accessibility(), port_.ports().notices, loop_, sources_.userDefaults(),
                                      [this](const std::string& sentence) { voice_.say(sentence); },
                                      sources_.writableSettings()});
        consent.begin();
        begin();
        std::thread tapThread([this] {
            port_.tapLoop().run();
            port_.leave();
        });
        loop_.run();
        expansion_.end();
        port_.tapLoop().perform([this] { port_.tapLoop().stop(); });
        tapThread.join();
        return status_;
    }

  private:
    void end(int status) {
        status_ = status;
        loop_.stop();
    }

    void begin() {
        expansion_.begin(sources_.libraryUpdate(), sources_.settings());
        sources_.begin(
            [this] {
                if (auto update = sources_.libraryUpdate()) expansion_.setLibrary(*std::move(update));
            },
            [this] { expansion_.loadPreferences(sources_.settings()); });
        expansion_.start();
        // What happens to the keyboard during a sleep, nobody hears.
        port_.setSleepListener(
            [this](bool sleeps) { sleeps ? expansion_.disableEvents() : expansion_.enableEvents(); });
        // After the start, which hears the keys from the loop, too.
        expansion_.ask([this](AutoText&) {
            port_.tapLoop().perform([this] { loop_.perform([this] { tellWhetherStarted(); }); });
        });
    }

    void tellWhetherStarted() {
        expansion_.examine([this](const Expansion::Findings& findings) {
            // What is missing was told already.
            if (!findings.evenTapCreated) return end(ExitStatus::MissingSystem);
            output_ << "Plume is ready: " << sources_.description() << ". Ctrl+C ends it." << std::endl;
        });
    }

    // Or the next change of any setting would undo what the hot key did.
    void enabledChanged(bool enabled) override {
        WritableUserDefaults* settings = sources_.writableSettings();
        if (!settings) return;
        if (const auto kept = settings->setObject("IsEnabled", enabled); !kept) voice_.say(kept.error().message);
    }

    void keyboardTapGivenUp() override {
        port_.ports().notices.show({"Plume does not listen",
                                    "Listening to the keyboard was ended three times within a minute, because Plume "
                                    "did not answer in time. It is tried again in a minute.",
                                    {{"Listen now", [this] { expansion_.tryTapAgain(); }}}});
    }

    void reported(const std::string& sentence) override { voice_.say(sentence); }
    void snippetUsed(const Uuid& /*snippet*/) override {}
    void secureInputChanged() override {}
    void hotKeyPressed(HotKeyForWindow /*hotKey*/) override {}

    PollRunLoop& loop_;
    LinuxPort& port_;
    RunSources& sources_;
    std::ostream& output_;
    Voice& voice_;
    std::atomic<int> status_ = ExitStatus::Success;
    Expansion expansion_;
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
    PollRunLoop loop;
    const auto port = LinuxPort::open(loop, {}, soundFolder());
    if (!port) return refuse(port.error(), ExitStatus::MissingSystem);
    const Result<InstanceLock> lock = InstanceLock::take({});
    if (!lock) return refuse(lock.error(), ExitStatus::Failure);
    const auto sources = RunSources::open({file.value().get(), settings.value(), loop, port.value()->ports().notices,
                                           [&voice](const std::string& sentence) { voice.say(sentence); }});
    if (!sources) return refuse(sources.error(), ExitStatus::Failure);
    if (const auto watched = port.value()->startWatchdog(); !watched) {
        return refuse(watched.error(), ExitStatus::MissingSystem);
    }
    return Run(loop, *port.value(), *sources.value(), output, voice).untilAskedToEnd(signals.get());
}

}  // namespace plume
