// A desk to try the engine at: a simulated keyboard in front of it, and behind it collaborators that write down what
// they are asked to do.
#pragma once

#include <functional>
#include <optional>
#include <string>
#include <vector>

#include "engine/AutoText.h"
#include "library/MemoryUserDefaults.h"
#include "ports/simulated/SimulatedInputService.h"
#include "ports/simulated/SimulatedInputSources.h"
#include "ports/simulated/SimulatedProcessManager.h"
#include "ports/simulated/SimulatedRunLoop.h"

namespace plume {

// Sends nothing, but clears the engine as sending does.
class RecordingSender final : public SnippetSender {
  public:
    struct Sent {
        std::u16string abbreviation;  // of the snippet
        std::optional<std::u16string> typed;
        SnippetTriggers trigger;
        std::u16string lettersBefore;
        bool listVisible;
        bool operator==(const Sent&) const = default;
    };

    bool sendSnippet(EngineState& engine, const std::shared_ptr<Snippet>& snippet,
                     const std::optional<std::u16string>& abbreviation, SnippetTriggers snippetTrigger) override;
    bool undo(EngineState& /*engine*/, bool /*withTrigger*/) override { return false; }

    std::vector<Sent> sent;
    bool swallows = true;
    std::u16string lettersAfter;  // what the expansion leaves in the buffer
    const bool* listVisible = nullptr;
};

class RecordingCorrector final : public AutoCorrector {
  public:
    void autoCorrect(EngineState& engine, ZDKeyEventArgs& event, std::u16string_view context) override;

    struct Asked {
        std::u16string context;
        std::u16string key;
        std::u16string letters;
        bool operator==(const Asked&) const = default;
    };
    std::vector<Asked> asked;
    bool swallows = false;
};

// Offers every snippet whose abbreviation starts with the whole buffer.
class PrefixSuggestions final : public SuggestionSource {
  public:
    void appendSuggestions(std::u16string_view letters, const EngineState::Groups& groups,
                           SuggestionList& list) const override;
};

// What the suggestion list looks like from outside.
struct ListWindow {
    int made = 0;
    bool visible = false;
    int shownAtCaret = 0;
    int heights = 0;
    std::size_t selected = 0;
    std::int64_t modifier = -1;
    std::vector<std::u16string> entries;  // abbreviations, as of the last reading
    Rectangle frame{{100, 100}, {200, 50}};
    std::function<void()> click;
};

struct SearchWindow {
    int made = 0;
    bool visible = false;
    bool atTopRightCorner = false;
    std::int64_t modifier = -1;
    std::size_t groupCount = 0;
    std::vector<std::shared_ptr<Snippet>> results;
    std::shared_ptr<Snippet> selected;
    Rectangle frame{{400, 100}, {200, 50}};
    std::function<void()> choose;
};

// Windows that write down what becomes of them.
std::unique_ptr<SuggestionController> makeRecordedList(ListWindow& window);
std::unique_ptr<QuickSearchController> makeRecordedSearch(SearchWindow& window);

class EngineDesk {
  public:
    // An enabled engine with an editor in front of it.
    EngineDesk();

    // A group of its own, last in the library, for these abbreviations.
    std::shared_ptr<SnippetGroup> add(const std::vector<std::u16string>& abbreviations,
                                      ExpandTrigger trigger = ExpandTrigger::Immediately);
    // Types what several snippets with this abbreviation match, and lets the list open.
    void openListOf(int count, const std::u16string& abbreviation = u"ab");
    // The key that types this character, with these modifiers held.
    bool press(char16_t character, KeyModifiers modifiers);

    SimulatedProcessManager processes;
    SimulatedInputSources sources;
    MemoryUserDefaults defaults;
    SimulatedRunLoop loop;
    SimulatedInputService service{processes, sources, loop};
    BundleIdentifierResolver resolver{processes};
    RecordingSender sender;
    RecordingCorrector corrector;
    PrefixSuggestions suggestionSource;
    ListWindow list;
    SearchWindow search;
    ProcessSerialNumber editor;
    AutoText engine;
};

}  // namespace plume
