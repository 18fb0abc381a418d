// A desk to try sending at: what is typed and what is sent ends on one screen, forms are filled by the test, scripts
// answer what the test says.
#pragma once

#include <functional>
#include <memory>
#include <mutex>
#include <optional>
#include <string>
#include <vector>

#include "engine/AutoCorrection.h"
#include "engine/AutoText.h"
#include "engine/SendingPipeline.h"
#include "library/MemoryUserDefaults.h"
#include "ports/simulated/SimulatedAccessibility.h"
#include "ports/simulated/SimulatedInputService.h"
#include "ports/simulated/SimulatedInputSources.h"
#include "ports/simulated/SimulatedProcessManager.h"
#include "ports/simulated/SimulatedRunLoop.h"
#include "tests/engine/EngineDesk.h"

namespace plume {

// Runs on the pipeline's threads.
class AnsweringRunner final : public ScriptRunner {
  public:
    using Answer = std::function<std::optional<std::u16string>(const std::u16string&)>;

    std::optional<std::u16string> run(std::u16string_view script, bool isAppleScript) override;
    // Set before anything runs. By default a script prints itself between angle brackets.
    Answer answer = [](const std::u16string& script) { return u"<" + script + u">"; };
    std::vector<std::u16string> ran() const;

  private:
    mutable std::mutex mutex_;
    std::vector<std::u16string> ran_;
};

class PlayedSounds final : public Sounds {
  public:
    void play(std::string_view name) override { names.emplace_back(name); }
    std::vector<std::string> names;
};

class TestForm final : public FieldsEditor {
  public:
    TestForm(std::shared_ptr<SnippetExpandedContent> content, Target& target, std::vector<TestForm*>& open);
    ~TestForm() override;
    TestForm(const TestForm&) = delete;
    TestForm& operator=(const TestForm&) = delete;

    void show() override { shown = true; }
    const std::shared_ptr<SnippetExpandedContent>& content() const override { return content_; }

    // Writes the values into the fields, in order, and confirms.
    void accept(const std::vector<std::u16string>& values);
    void dismiss() { target_.fieldsEditorWillClose(*this); }

    bool shown = false;

  private:
    std::shared_ptr<SnippetExpandedContent> content_;
    Target& target_;
    std::vector<TestForm*>& open_;
};

class SendingDesk {
  public:
    // An enabled engine with an editor in front of it.
    SendingDesk();

    // A snippet in a group of its own, last in the library.
    std::shared_ptr<Snippet> add(std::u16string abbreviation, std::u16string content,
                                 ExpandTrigger trigger = ExpandTrigger::Immediately,
                                 ContentType type = ContentType::PlainText);
    // Key by key; what is sent meanwhile and what is let through comes to the screen.
    void type(std::u16string_view text);
    bool undo(bool withTrigger);
    // Lets scripts end and everything that is due happen.
    void settle();
    // Brings what was sent since the last time to the screen.
    const std::u16string& screen();
    const PLOutput& lastOutput() const { return *service.outputs().back(); }

    SimulatedProcessManager processes;
    SimulatedInputSources sources;
    MemoryUserDefaults defaults;
    SimulatedRunLoop loop;
    SimulatedAccessibility accessibility;
    SimulatedInputService service{processes, sources, loop};
    BundleIdentifierResolver resolver{processes};
    AnsweringRunner runner;
    PlayedSounds sounds;
    std::vector<TestForm*> forms;  // that exist
    std::vector<std::string> reports;
    SnippetParser parser{ContentEnvironment{}};
    SendingPipeline pipeline;
    AutoCorrection correction;
    PrefixSuggestions suggestionSource;
    ListWindow list;
    SearchWindow search;
    AutoText engine;

  private:
    std::u16string screen_;
    std::size_t outputsOnScreen_ = 0;
};

}  // namespace plume
