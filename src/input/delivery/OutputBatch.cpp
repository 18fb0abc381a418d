#include "input/delivery/OutputBatch.h"

#include <algorithm>
#include <cstddef>
#include <memory>
#include <utility>
#include <variant>

namespace plume {

namespace {

using Kind = OutputStep::Kind;
using KeyFragment = std::shared_ptr<SnippetKeyVariable>;

constexpr std::uint64_t EventsInABatch = 20;
constexpr double BatchPause = 0.04;  // seconds
constexpr double MinimumPastingDelay = 0.005;
constexpr double ActivationPause = 0.4;

bool isKey(const PLOutput::Fragment& fragment) {
    return std::holds_alternative<KeyFragment>(fragment);
}

// Typed text would overtake the keys at the end of the batch. A paste is a key, too, and does not.
bool hasToSettle(const OutputBatch& batch, const ContextInputSetting& setting) {
    if (setting.afterErasingDelay <= 0 || batch.steps.empty()) return false;
    const Kind last = batch.steps.back().kind;
    return last != Kind::Text && last != Kind::Paste;
}

// Takes one batch apart, front to back.
class BatchTaker {
  public:
    BatchTaker(PLOutput& output, const ContextInputSetting& setting) : output_(output), setting_(setting) {}

    OutputBatch take() {
        if (!takeBackspaces()) return std::move(batch_);
        // Exactly a whole batch of backspaces ends an output: what programs have come to expect.
        if (budget_ == 0) {
            if (hasToSettle(batch_, setting_)) pauseFor(setting_.afterErasingDelay);
            return std::move(batch_);
        }
        const bool goesOn = takeFragments();
        output_.fragments.erase(output_.fragments.begin(), output_.fragments.begin() + taken_);
        if (goesOn) takeLeftArrows();
        // What the user types next is to find the keys' work done, too.
        if (!batch_.pause && hasToSettle(batch_, setting_)) pauseFor(setting_.afterErasingDelay);
        return std::move(batch_);
    }

  private:
    // Each says whether the batch goes on behind it.
    bool takeBackspaces() {
        if (output_.backspaceCount == 0) return true;
        const std::uint64_t count = takeCount(output_.backspaceCount);
        batch_.steps.push_back({Kind::Backspaces, count, {}});
        return output_.backspaceCount == 0 || pauseFor(BatchPause);
    }

    bool takeFragments() {
        while (static_cast<std::size_t>(taken_) < output_.fragments.size()) {
            PLOutput::Fragment& fragment = output_.fragments[static_cast<std::size_t>(taken_)];
            if (isTyped(fragment) && hasToSettle(batch_, setting_)) return pauseFor(setting_.afterErasingDelay);
            const bool goesOn = isKey(fragment) ? takeKey(fragment) : takeText(fragment);
            if (!goesOn) return false;
            if (budget_ == 0) return pauseFor(BatchPause);
        }
        return true;
    }

    bool takeKey(PLOutput::Fragment& fragment) {
        const KeyFragment key = std::get<KeyFragment>(fragment);
        std::uint64_t left = key->count;
        const std::uint64_t count = takeCount(left);
        if (count > 0) batch_.steps.push_back({Kind::Key, count, key});
        if (left > 0) {
            // A copy, because the content that it comes from keeps its keys.
            auto rest = std::make_shared<SnippetKeyVariable>(*key);
            rest->count = left;
            fragment = std::move(rest);
        } else {
            ++taken_;
        }
        if (key->delay > 0) return pauseFor(key->delay);
        // What the key did has to be seen before something is pasted.
        return left > 0 || !nextIsPasted() || pauseFor(BatchPause);
    }

    bool takeText(PLOutput::Fragment& fragment) {
        ++taken_;
        --budget_;
        const bool paste = isPasted(fragment);
        batch_.steps.push_back({paste ? Kind::Paste : Kind::Text, 1, std::move(fragment)});
        const double pause = paste ? pauseAfterPaste(setting_) : 0;
        return pause <= 0 || pauseFor(pause);
    }

    void takeLeftArrows() {
        if (output_.leftArrowCount == 0) return;
        const std::uint64_t count = takeCount(output_.leftArrowCount);
        batch_.steps.push_back({Kind::LeftArrows, count, {}});
        if (output_.leftArrowCount > 0) pauseFor(BatchPause);
    }

    std::uint64_t takeCount(std::uint64_t& available) {
        const std::uint64_t count = std::min(available, budget_);
        available -= count;
        budget_ -= count;
        return count;
    }

    bool isPasted(const PLOutput::Fragment& fragment) const {
        return std::holds_alternative<AttributedString>(fragment) || setting_.has(InputFlag::UseClipboard);
    }

    bool isTyped(const PLOutput::Fragment& fragment) const { return !isKey(fragment) && !isPasted(fragment); }

    bool nextIsPasted() const {
        const auto next = static_cast<std::size_t>(taken_);
        return next < output_.fragments.size() && !isKey(output_.fragments[next]) && isPasted(output_.fragments[next]);
    }

    bool pauseFor(double seconds) {
        batch_.pause = hasToSettle(batch_, setting_) ? std::max(seconds, setting_.afterErasingDelay) : seconds;
        return false;
    }

    PLOutput& output_;
    const ContextInputSetting& setting_;
    OutputBatch batch_;
    std::uint64_t budget_ = EventsInABatch;
    std::ptrdiff_t taken_ = 0;
};

}  // namespace

OutputBatch takeBatch(PLOutput& output, const ContextInputSetting& setting) {
    return BatchTaker(output, setting).take();
}

bool isSentInOneBatch(const PLOutput& output, const ContextInputSetting& setting) {
    PLOutput rest = output;
    const OutputBatch first = takeBatch(rest, setting);
    if (!first.pause) return true;
    if (hasToSettle(first, setting)) return false;
    const bool pastesLater =
        pauseAfterPaste(setting) > 0 && std::any_of(first.steps.begin(), first.steps.end(),
                                                    [](const OutputStep& step) { return step.kind == Kind::Paste; });
    return !pastesLater && rest.backspaceCount == 0 && rest.fragments.empty() && rest.leftArrowCount == 0;
}

bool pastesByActivation(const ContextInputSetting& setting) {
    return setting.has(InputFlag::UseVMHelper) || setting.has(InputFlag::Reactivate);
}

double pasteKeystrokeDelay(const ContextInputSetting& setting) {
    return setting.has(InputFlag::DelayPasting) ? std::max(setting.pastingDelay, MinimumPastingDelay) : 0;
}

double pauseAfterPaste(const ContextInputSetting& setting) {
    if (pastesByActivation(setting)) return ActivationPause;
    return pasteKeystrokeDelay(setting) + setting.afterPastingDelay;
}

double pauseAfterTaking(const ContextInputSetting& setting) {
    return pastesByActivation(setting) ? 0 : setting.afterPastingDelay;
}

}  // namespace plume
