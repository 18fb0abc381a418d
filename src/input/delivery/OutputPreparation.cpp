#include "input/delivery/OutputPreparation.h"

#include <memory>
#include <variant>

#include "Foundation/KeyCode.h"
#include "Foundation/KeyModifiers.h"
#include "input/delivery/OutputBatch.h"
#include "input/delivery/OutputFragments.h"
#include "library/Snippet.h"
#include "library/SnippetGroup.h"

namespace plume {

namespace {

// What can be passed on behind an output, in events.
constexpr std::uint64_t ShortOutput = 20;

// The groups say whether the text keeps the delimiter that was typed behind an abbreviation.
class Preparation {
  public:
    Preparation(PLOutput& output, const ContextInputSetting& setting, const TriggerKey& key)
        : output_(output), setting_(setting), key_(key), content_(output.snippetExpandedContent.get()) {
        if (content_ && content_->originalSnippet) group_ = content_->originalSnippet->parentGroup();
        keepsDelimiter_ = group_ && group_->expandTrigger() == ExpandTrigger::DelimiterKept &&
                          output_.trigger == SnippetTrigger::Typed;
    }

    void prepare(bool mustWait) {
        if (!output_.cancelTrigger) output_.cancelTrigger = mustWait || isDelayed();
        if (needsUnstyledDelimiter()) {
            content_->suffix = key_.string.value_or(u"");
            output_.cancelTrigger = true;
        }
        bool suffixApplied = false;
        if (!output_.cancelTrigger) {
            applySuffix();
            suffixApplied = true;
            refreshFragmentsForOuput(output_, setting_);
            output_.cancelTrigger = eventCountForOutput(output_) > ShortOutput || !isSentInOneBatch(output_, setting_);
        }
        if (!output_.cancelTrigger) return;
        if (content_ && content_->suffix.empty() && keepsDelimiter_) {
            content_->suffix = key_.string.value_or(u"");
            suffixApplied = false;
        }
        if (!suffixApplied) applySuffix();
        refreshFragmentsForOuput(output_, setting_);
        pressSuffixBehindPaste();
    }

  private:
    bool isDelayed() const {
        const bool pausesForPaste = setting_.has(InputFlag::DelayPasting) || setting_.afterPastingDelay > 0;
        if (setting_.has(InputFlag::UseClipboard) && pausesForPaste) return true;
        return content_ && content_->hasDelayedKey();
    }

    // A delimiter typed behind rich text would take its look; appended to the text it has none.
    bool needsUnstyledDelimiter() const {
        if (!keepsDelimiter_ || !group_->resetFormatting() || !content_->isRich() || !content_->suffix.empty()) {
            return false;
        }
        const auto code = key_.keyCode;
        return code && *code != KeyCode::Return && *code != KeyCode::Tab && *code != KeyCode::KeypadEnter;
    }

    void applySuffix() {
        if (content_) content_->applySuffix();
    }

    // Pasted, a Return or a Tab is text at best, but people mean the key: it sends, or leaves the field.
    void pressSuffixBehindPaste() {
        const bool isPasted = setting_.has(InputFlag::UseClipboard) && !pastesByActivation(setting_);
        const KeyCode code = content_ ? keyOfSuffix(content_->suffix) : KeyCode::None;
        if (!isPasted || code == KeyCode::None || output_.fragments.empty()) return;
        auto* const text = std::get_if<std::u16string>(&output_.fragments.back());
        if (!text || !text->ends_with(content_->suffix)) return;
        text->resize(text->size() - content_->suffix.size());
        if (text->empty()) output_.fragments.pop_back();
        output_.fragments.emplace_back(std::make_shared<SnippetKeyVariable>(content_->suffix, code));
    }

    static KeyCode keyOfSuffix(std::u16string_view suffix) {
        if (suffix == u"\r") return KeyCode::Return;
        return suffix == u"\t" ? KeyCode::Tab : KeyCode::None;
    }

    PLOutput& output_;
    const ContextInputSetting& setting_;
    const TriggerKey& key_;
    SnippetExpandedContent* content_;
    std::shared_ptr<SnippetGroup> group_;
    bool keepsDelimiter_ = false;
};

}  // namespace

void prepareOutput(PLOutput& output, const ContextInputSetting& setting, const TriggerKey& key, bool mustWait) {
    Preparation(output, setting, key).prepare(mustWait);
}

}  // namespace plume
