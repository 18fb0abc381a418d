// A settings window on simulated files, with a program around it that notes what it is asked.
#pragma once

#include <gtest/gtest.h>

#include <QApplication>
#include <QLabel>
#include <QLineEdit>
#include <QListWidget>
#include <QMessageBox>
#include <QPointer>
#include <QPushButton>
#include <QTest>
#include <algorithm>
#include <string>
#include <utility>
#include <vector>

#include "app/preferences/PreferencesWindow.h"
#include "tests/library/LibraryMachine.h"

namespace plume::test {

// Settings that cannot be written while the disk is full.
class FillingUserDefaults final : public WritableUserDefaults {
  public:
    explicit FillingUserDefaults(MemoryUserDefaults& kept) : kept_(kept) {
        changed_ = kept_.changedEvent.addObserver(this, &FillingUserDefaults::pass);
    }
    bool isFull = false;

    std::optional<PropertyList> objectForKey(std::string_view key) const override { return kept_.objectForKey(key); }
    void registerDefaults(const PropertyList::Dictionary& defaults) override { kept_.registerDefaults(defaults); }
    Result<void> setObject(std::string_view key, PropertyList value) override {
        if (isFull) return Error{"The disk is full."};
        return kept_.setObject(key, std::move(value));
    }
    Result<void> removeObject(std::string_view key) override {
        if (isFull) return Error{"The disk is full."};
        return kept_.removeObject(key);
    }
    std::vector<std::string> ownKeys() const override { return kept_.ownKeys(); }

  private:
    void pass(UserDefaultsChange& change) { changedEvent.raise(change); }

    MemoryUserDefaults& kept_;
    Subscription changed_;
};

inline const char* builtInRows() {
    return R"({"default": {"flags": ["useClipboardIfHasNewLine"], "pasteKeys": ["Control+V"]},
               "families": {"terminal": {"flags": ["useClipboardIfHasNewLine"], "pasteKeys": ["Control+Shift+V"]},
                            "office": {"afterErasingDelay": 0.04}},
               "applications": {"kitty": {"family": "terminal"}, "libreoffice*": {"family": "office"},
                                "libreoffice-writer": {"about": "Text", "family": "office"}}})";
}

inline RunningApplication program(std::optional<std::u16string> identifier, std::optional<std::u16string> name = {}) {
    return {.processIdentifier = 1,
            .bundleIdentifier = std::move(identifier),
            .localizedName = std::move(name),
            .executableURL = {}};
}

struct PreferencesWorld {
    SharedWorld world;
    Machine machine{world};
    FillingUserDefaults settings{machine.settings};

    std::function<void(const GeneralHotKey&)> pressed;
    int recordings = 0;
    int ended = 0;
    Result<void> desktopsAnswer;
    std::function<void(const Result<void>&)> heldAnswer;  // filled while answers are held back
    bool holdsAnswers = false;
    std::function<void(const std::optional<RunningApplication>&)> pointed;
    bool startsAtLogin = false;
    Result<void> startAtLoginAnswer;
    std::vector<std::string> played;
    std::vector<std::string> commands;
    int syncChanges = 0;
    int forgotten = 0;
    Result<void> forgetAnswer;

    ProgramServices programs() {
        return ProgramServices{
            .runningPrograms =
                [](auto told) {
                    told({program(u"kitty", u"Kitty"), program(u"mychat", u"My Chat"), program(u"mychat", u"My Chat"),
                          program({}, u"Nameless")});
                },
            .nextFrontProgram = [this](auto told) { pointed = std::move(told); },
            .installedPrograms =
                [] {
                    return std::vector<InstalledProgram>{{u"kitty", u"Kitty Terminal", ""},
                                                         {u"org.gnome.gedit", u"Text Editor \u65E5\u672C", "none"}};
                },
        };
    }
    PreferencesServices services() {
        const auto command = [this](const char* name) { return [this, name] { commands.emplace_back(name); }; };
        return PreferencesServices{
            .settings = settings,
            .dataManager = *machine.manager,
            .beginRecordingHotKey =
                [this](auto to) {
                    pressed = std::move(to);
                    ++recordings;
                },
            .endRecordingHotKey = [this] { ++ended; },
            .tryHotKey =
                [this](const GeneralHotKey&, auto told) {
                    if (holdsAnswers)
                        heldAnswer = std::move(told);
                    else
                        told(desktopsAnswer);
                },
            .keyName = [](KeyCode key) -> std::u16string {
                if (key == KeyCode::K) return u"K";
                return key == KeyCode::F5 ? u"F5" : u"";
            },
            .programs = programs(),
            .builtInApplicationRows = builtInRows(),
            .startsAtLogin = [this] { return startsAtLogin; },
            .setStartsAtLogin =
                [this](bool starts) {
                    if (startAtLoginAnswer) startsAtLogin = starts;
                    return startAtLoginAnswer;
                },
            .soundNames = {"Click", "Pop"},
            .playSound = [this](const std::string& name) { played.push_back(name); },
            .importFile = command("import"),
            .exportLibrary = command("export"),
            .restore = command("restore"),
            .syncSettingsChanged = [this] { ++syncChanges; },
            .showDiagnostics = command("diagnostics"),
            .forgetSnippetUses =
                [this] {
                    ++forgotten;
                    return forgetAnswer;
                },
        };
    }
};

// What a user finds by what it is called.
template <typename Widget>
Widget* named(QWidget& in, const QString& name) {
    for (auto* widget : in.findChildren<Widget*>()) {
        if (widget->accessibleName() == name && widget->isVisibleTo(&in)) return widget;
    }
    return nullptr;
}

template <typename Widget>
Widget* withText(QWidget& in, const QString& text) {
    for (auto* widget : in.findChildren<Widget*>()) {
        if (widget->text().remove(u'&') == text && widget->isVisibleTo(&in)) return widget;
    }
    return nullptr;
}

inline void bringUp(QWidget& window) {
    window.show();
    window.activateWindow();
    QCoreApplication::processEvents();
}

// Closed windows and answered dialogs go.
inline void letGo() {
    QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
}

inline constexpr const char* Pages[] = {"General", "Expansion",    "Search",  "Typing",       "Correction",
                                        "HotKeys", "Applications", "Backups", "ImportExport", "Advanced"};

// The window, open at its first page.
class PreferencesWindowTest : public testing::Test, protected PreferencesWorld {
  protected:
    PreferencesWindowTest() { open(); }
    ~PreferencesWindowTest() override {
        delete window_;
        letGo();
    }

    void open() {
        window_ = new PreferencesWindow(services());
        bringUp(*window_);
    }
    PreferencesWindow& window() { return *window_; }
    void search(const char* words) {
        auto* line = named<QLineEdit>(window(), "Search settings");
        line->setText(words);
    }
    QListWidget* hits() { return named<QListWidget>(window(), "Settings that were found"); }
    QString complaint() {
        auto* label = named<QLabel>(window(), "What went wrong");
        return label ? label->text() : QString();
    }
    static void answer(const QString& button) {
        auto* question = qobject_cast<QMessageBox*>(QApplication::activeModalWidget());
        ASSERT_TRUE(question);
        QTest::mouseClick(withText<QPushButton>(*question, button), Qt::LeftButton);
        letGo();
    }

    QPointer<PreferencesWindow> window_;
};

}  // namespace plume::test
