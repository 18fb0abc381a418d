// The input service's answers to any sequence of keys and modifiers, against rules that look back over the whole
// history.
#include <gtest/gtest.h>
#include <rapidcheck/gtest.h>

#include <algorithm>
#include <utility>
#include <vector>

#include "tests/input/InputDesk.h"

namespace plume {
namespace {

struct Step {
    enum class Kind { Down, Up, Modifiers, Ignore };
    Kind kind;
    KeyCode key = KeyCode::None;
    KeyModifiers modifiers = {};
    bool swallowed = false;
};

using Kind = Step::Kind;
using History = std::vector<Step>;

// What the listeners swallow.
bool engineSwallows(KeyCode key) {
    return numberOf(key) % 2 == 0;
}
bool shortcutSwallows(const GeneralHotKey& hotKey) {
    return hotKey.keyCode == KeyCode::F;
}
bool hotKeySwallows(const GeneralHotKey& hotKey) {
    return hotKey.modifiers != KeyModifier::Shift;
}

class Model {
  public:
    explicit Model(std::vector<GeneralHotKey> hotKeys) : hotKeys_(std::move(hotKeys)) {}

    KeyModifiers held() const {
        for (auto step = history_.rbegin(); step != history_.rend(); ++step) {
            if (step->kind == Kind::Modifiers) return step->modifiers;
        }
        return {};
    }

    bool answer(Step step) {
        switch (step.kind) {
            case Kind::Down:
                step.swallowed = swallowsDown(step.key);
                break;
            case Kind::Up:
                step.swallowed = swallowsUp(step.key);
                break;
            case Kind::Modifiers:
                step.swallowed =
                    step.modifiers.bits() <= held().bits() && !theyServedAPurpose() && firesHotKey(KeyCode::None);
                break;
            case Kind::Ignore:
                break;
        }
        history_.push_back(step);
        return step.swallowed;
    }

  private:
    bool firesHotKey(KeyCode key) const {
        const GeneralHotKey pressed{held(), key};
        if (!pressed.isValid()) return false;
        return std::find(hotKeys_.begin(), hotKeys_.end(), pressed) != hotKeys_.end() && hotKeySwallows(pressed);
    }

    // The held modifiers belong to a key, or are the rest of a larger set.
    bool theyServedAPurpose() const {
        for (std::size_t i = history_.size(); i-- > 0;) {
            const Step& step = history_[i];
            const Model before(hotKeys_, {history_.begin(), history_.begin() + static_cast<std::ptrdiff_t>(i)});
            if (step.kind == Kind::Ignore) return true;
            if (step.kind == Kind::Down && !before.held().isEmpty()) return true;
            if (step.kind == Kind::Modifiers)
                return step.modifiers.bits() <= before.held().bits() && !step.modifiers.isEmpty();
        }
        return false;
    }

    bool isShortcut() const { return held().containsAny(KeyModifier::Control | KeyModifier::Command); }

    bool swallowsDown(KeyCode key) const {
        if (firesHotKey(key)) return true;
        return isShortcut() ? shortcutSwallows({held(), key}) : engineSwallows(key);
    }

    // The last key that was swallowed, while its release is still to come.
    bool swallowsUp(KeyCode key) const {
        for (auto step = history_.rbegin(); step != history_.rend(); ++step) {
            if (step->kind == Kind::Up && step->swallowed) return false;
            if (step->kind == Kind::Down && step->swallowed) return step->key == key;
        }
        return false;
    }

    Model(std::vector<GeneralHotKey> hotKeys, History history)
        : hotKeys_(std::move(hotKeys)), history_(std::move(history)) {}

    std::vector<GeneralHotKey> hotKeys_;
    History history_;
};

struct Swallowers {
    void key(ZDKeyEventArgs& event) { event.cancel = engineSwallows(event.key); }
    void shortcut(ZDUnregisteredHotKeyPressedEventArgs& event) { event.cancel = shortcutSwallows(event.hotKey); }
    void hotKeys(ZDHotKeysPressedEventArgs& event) { event.cancel = hotKeySwallows(event.hotKeys.front()); }
};

KeyModifiers randomModifiers() {
    return KeyModifiers::fromBits(*rc::gen::inRange(0, 16));
}

Step randomStep() {
    Step step{*rc::gen::element(Kind::Down, Kind::Down, Kind::Up, Kind::Modifiers, Kind::Modifiers, Kind::Ignore)};
    step.key = *rc::gen::element(KeyCode::S, KeyCode::D, KeyCode::F, KeyCode::H);
    step.modifiers = randomModifiers();
    return step;
}

GeneralHotKey randomHotKey() {
    return {randomModifiers(), *rc::gen::element(KeyCode::S, KeyCode::D, KeyCode::F, KeyCode::None, KeyCode::None)};
}

bool answerOf(InputDesk& desk, const Step& step) {
    switch (step.kind) {
        case Kind::Down:
            return desk.keyDown(step.key, u"x");
        case Kind::Up:
            return desk.keyUp(step.key);
        case Kind::Modifiers:
            return desk.hold(step.modifiers);
        case Kind::Ignore:
            break;
    }
    desk.service.ignoreNextHotKey();
    return false;
}

RC_GTEST_PROP(TapModel, AnswersAsTheRulesSay, ()) {
    InputDesk desk;
    Swallowers swallowers;
    const Subscription subscription = desk.service.keyDownEvent.addObserver(&swallowers, &Swallowers::key);
    const Subscription subscription2 =
        desk.service.unregisteredHotKeyPressedEvent.addObserver(&swallowers, &Swallowers::shortcut);
    const Subscription subscription3 = desk.service.hotKeysPressed.addObserver(&swallowers, &Swallowers::hotKeys);

    std::vector<GeneralHotKey> hotKeys;
    for (int i = *rc::gen::inRange(0, 12); i > 0; --i) hotKeys.push_back(randomHotKey());
    for (const auto& hotKey : hotKeys) desk.service.registerHotKey(hotKey);
    Model model(hotKeys);

    for (int i = *rc::gen::inRange(1, 40); i > 0; --i) {
        const Step step = randomStep();
        const bool expected = model.answer(step);
        RC_ASSERT(answerOf(desk, step) == expected);
        RC_ASSERT(desk.service.keyModifier() == model.held());
    }
}

}  // namespace
}  // namespace plume
