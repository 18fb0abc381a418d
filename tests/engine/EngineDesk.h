// A desk to try the engine at: a simulated desktop with an editor in front, the real input service between them,
// windows that write down what becomes of them, forms that the test closes, and scripts that answer what the test
// says.
#pragma once

#include <functional>
#include <memory>
#include <mutex>
#include <optional>
#include <string>
#include <vector>

#include "engine/AutoText.h"
#include "library/MemoryUserDefaults.h"
#include "ports/simulated/SimulatedDesktop.h"

namespace plume {

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
    std::optional<std::u16string> typedText;
    Rectangle frame{{400, 100}, {200, 50}};
    std::function<void()> choose;
};

class TestForm final : public FieldsEditor {
  public:
    TestForm(std::shared_ptr<SnippetExpandedContent> content, Target& target, std::vector<TestForm*>& open);
    ~TestForm() override;
    TestForm(const TestForm&) = delete;
    TestForm& operator=(const TestForm&) = delete;

    void show() override { shown = true; }
    const std::shared_ptr<SnippetExpandedContent>& content() const override { return content_; }
    void close() { target_.fieldsEditorWillClose(*this); }

    bool shown = false;

  private:
    std::shared_ptr<SnippetExpandedContent> content_;
    Target& target_;
    std::vector<TestForm*>& open_;
};

// Runs on the engine's threads.
class AnsweringRunner final : public ScriptRunner {
  public:
    std::optional<std::u16string> run(std::u16string_view script, bool isAppleScript) override;
    bool canRunAppleScript() override { return true; }
    // Set before anything runs. By default a script prints itself between angle brackets.
    std::function<std::optional<std::u16string>(const std::u16string&)> answer = [](const std::u16string& script) {
        return u"<" + script + u">";
    };
};

class EngineDesk {
  public:
    // An enabled engine.
    EngineDesk();

    // A group of its own, last in the library, for these abbreviations; each stands for "content".
    std::shared_ptr<SnippetGroup> add(const std::vector<std::u16string>& abbreviations,
                                      ExpandTrigger trigger = ExpandTrigger::Immediately);
    // The same for one snippet.
    std::shared_ptr<Snippet> add(std::u16string abbreviation, std::u16string content,
                                 ExpandTrigger trigger = ExpandTrigger::Immediately,
                                 ContentType type = ContentType::PlainText);
    // Key by key; what is due after each key happens.
    void type(std::u16string_view text);
    // The key that types this character, with these modifiers held.
    void press(char16_t character, KeyModifiers modifiers);
    void clickAt(double x, double y);
    // Types the beginning of abbreviations and asks what it may become.
    void suggest(std::u16string_view beginning);
    // Lets scripts end and everything that is due within a second happen.
    void settle();
    // What stands in the program in front.
    const std::u16string& screen() { return desktop.front()->field().text(); }

    SimulatedDesktop desktop;
    SimulatedRunLoop& loop = desktop.runLoop();
    MemoryUserDefaults defaults;
    BundleIdentifierResolver identifiers{desktop.processManager()};
    MacInputService service;
    AnsweringRunner runner;
    std::vector<TestForm*> forms;  // that exist
    ListWindow list;
    SearchWindow search;
    SnippetParser parser{ContentEnvironment{}};
    std::unique_ptr<AutoText> owner;
    AutoText& engine;

  private:
    AutoText::Dependencies dependencies();
};

}  // namespace plume
