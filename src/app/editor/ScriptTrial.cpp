#include "app/editor/ScriptTrial.h"

#include <utility>

#include "Foundation/Strings.h"
#include "app/FormModel.h"
#include "content/FieldMerging.h"
#include "content/NestedScripts.h"
#include "content/PLScript.h"
#include "content/SnippetParser.h"
#include "content/scripts/ShellScriptRunner.h"

namespace plume {

namespace {

class ShellTrialRunner final : public TrialRunner {
  public:
    ShellTrialRunner(ProcessLauncher& launcher, const ScriptLimits& limits)
        : runner_(
              launcher, [](const std::string&) {}, limits) {}

    ScriptOutput run(std::u16string_view script, bool isAppleScript) override {
        return runner_.outputOf(script, isAppleScript);
    }
    void stop() override { runner_.stop(); }

  private:
    ShellScriptRunner runner_;
};

bool isHighSurrogate(char16_t c) {
    return (c & 0xFC00) == 0xD800;
}

TriedText triedText(std::string_view bytes) {
    TriedText tried;
    const auto text = fromStrictUtf8(bytes);
    tried.isUtf8 = text.has_value();
    tried.text = text ? *text : fromUtf8(bytes);
    if (tried.text.size() <= TriedText::MaximumLength) return tried;
    std::size_t length = TriedText::MaximumLength;
    if (isHighSurrogate(tried.text[length - 1])) --length;
    tried.left = tried.text.size() - length;
    tried.text.resize(length);
    return tried;
}

}  // namespace

std::shared_ptr<TrialRunner> makeTrialRunner(ProcessLauncher& launcher, const ScriptLimits& limits) {
    return std::make_shared<ShellTrialRunner>(launcher, limits);
}

// Keeps what the scripts write besides handing it on.
class ScriptTrial::Recorder final : public ScriptRunner {
  public:
    Recorder(ScriptTrial& trial, TrialRunner& runner) : trial_(trial), runner_(runner) {}

    std::optional<std::u16string> run(std::u16string_view script, bool isAppleScript) override {
        last_ = runner_.run(script, isAppleScript);
        trial_.endings_.push_back({last_.end, last_.failed, last_.problem});
        errors_ += last_.error;
        return last_.delivered();
    }
    // What cannot be run says so itself.
    bool canRunAppleScript() override { return true; }

    // The output is that of the last script.
    void finish() const {
        trial_.output_ = triedText(last_.output);
        trial_.errors_ = triedText(errors_);
    }

  private:
    ScriptTrial& trial_;
    TrialRunner& runner_;
    ScriptOutput last_;
    std::string errors_;
};

std::shared_ptr<ScriptTrial> ScriptTrial::prepare(const std::shared_ptr<Snippet>& snippet, std::u16string_view text,
                                                  const SnippetGroups& groups, ContentEnvironment environment,
                                                  const std::string& locale) {
    auto content = SnippetParser(std::move(environment)).parse(snippet, text, groups);
    if (!content) return nullptr;
    auto trial = std::make_shared<ScriptTrial>();
    trial->isAppleScript_ = snippet->contentType() == ContentType::AppleScript;
    trial->hasFields_ = !content->fields().empty();
    FormModel(*content, locale).accept();
    mergeFields(*content);
    processScripts(*content);
    trial->content_ = std::move(content);
    return trial;
}

void ScriptTrial::run(TrialRunner& runner) {
    Recorder recorder(*this, runner);
    for (const auto& script : content_->scripts) script->execute(recorder);
    mergeScriptResults(*content_);
    PLScript whole;
    whole.script = content_->string();
    whole.isAppleScript = isAppleScript_;
    whole.execute(recorder);
    recorder.finish();
}

}  // namespace plume
