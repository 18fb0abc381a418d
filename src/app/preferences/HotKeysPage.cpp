#include <QCoreApplication>
#include <QLabel>
#include <array>

#include "app/HotKeyDispatch.h"
#include "app/preferences/HotKeyRecorder.h"
#include "app/preferences/PreferencesPages.h"

namespace plume {

namespace {

struct Command {
    const char* setting;
    const char* name;
    const char* help = "";
};

constexpr const char* Context = "HotKeysPage";

constexpr std::array Expansion{
    Command{"switchHotKey", QT_TRANSLATE_NOOP("HotKeysPage", "Switch expansion on and off")},
    Command{"ExpandHotKey", QT_TRANSLATE_NOOP("HotKeysPage", "Expand the abbreviation just typed")},
    Command{"UndoHotKey", QT_TRANSLATE_NOOP("HotKeysPage", "Undo the last expansion"),
            QT_TRANSLATE_NOOP("HotKeysPage", "The key that caused it comes back too.")},
    Command{"UndoAltHotKey", QT_TRANSLATE_NOOP("HotKeysPage", "Undo without that key"),
            QT_TRANSLATE_NOOP("HotKeysPage", "Only the abbreviation comes back.")},
};
constexpr std::array Finding{
    Command{"suggestAbbreviationsHotKey", QT_TRANSLATE_NOOP("HotKeysPage", "Suggest abbreviations")},
    Command{"quickSearchHotKey", QT_TRANSLATE_NOOP("HotKeysPage", "Quick search")},
    Command{"QuickSearchHotKey", QT_TRANSLATE_NOOP("HotKeysPage", "Quick search, asked of the desktop"),
            QT_TRANSLATE_NOOP("HotKeysPage", "Works also where Plume does not hear the keys.")},
};
constexpr std::array Snippets{
    Command{"openMainWindowHotKey", QT_TRANSLATE_NOOP("HotKeysPage", "Open the snippets window")},
    Command{"OpenLastUsedSnippetHotKey", QT_TRANSLATE_NOOP("HotKeysPage", "Open the snippet used last")},
    Command{"makeSnippetFromSelectionHotKey", QT_TRANSLATE_NOOP("HotKeysPage", "New snippet from the selection")},
    Command{"makeSnippetFromClipboardHotKey", QT_TRANSLATE_NOOP("HotKeysPage", "New snippet from the clipboard")},
};

QString translated(const char* text) {
    return *text ? QCoreApplication::translate(Context, text) : QString();
}

class HotKeysPage final : public PreferencesPage {
    Q_DECLARE_TR_FUNCTIONS(HotKeysPage)
  public:
    explicit HotKeysPage(const Around& around) : PreferencesPage(around) {
        addNote(tr("Click a field, or press Space in it, and then the keys that you want."));
        addAll(tr("Expanding"), Expansion);
        addAll(tr("Finding snippets"), Finding);
        addAll(tr("Making and changing snippets"), Snippets);
    }

  private:
    template <typename Commands>
    void addAll(const QString& heading, const Commands& commands) {
        addHeading(heading);
        for (const Command& command : commands) add(command);
    }

    void add(const Command& command) {
        const char* key = command.setting;
        auto* recorder =
            new HotKeyRecorder(services(), [this, key](const GeneralHotKey& hotKey) { return holder(key, hotKey); });
        recorder->setName(translated(command.name));
        addField(translated(command.name), recorder, translated(command.help), {QLatin1String(key)});
        bind(key, [this, key, recorder] { recorder->setHotKey(HotKeyDispatch::hotKeyIn(settings(), key)); });
        connect(recorder, &HotKeyRecorder::edited, this, [this, key](const std::optional<GeneralHotKey>& hotKey) {
            hotKey ? write(key, hotKey->getValue()) : giveUp(key);
        });
    }

    // What besides this setting has the hot key, in words.
    QString holder(std::string_view setting, const GeneralHotKey& hotKey) const {
        QString name;
        const auto look = [&](const auto& commands) {
            for (const Command& command : commands) {
                const bool holds = HotKeyDispatch::hotKeyIn(settings(), command.setting) == hotKey;
                if (holds && command.setting != setting) name = translated(command.name);
            }
        };
        look(Expansion);
        look(Finding);
        look(Snippets);
        return name;
    }
};

}  // namespace

PreferencesPage* makeHotKeysPage(const PreferencesPage::Around& around) {
    return new HotKeysPage(around);
}

}  // namespace plume
