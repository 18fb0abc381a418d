#include "app/FormBridge.h"

#include <utility>

namespace plume {

namespace {

// Seconds.
constexpr double LongestOpening = 3;  // until the form has the keyboard
constexpr double LongestClosing = 1.5;
constexpr double LongestDoubt = 0.3;     // whether a key has ended the form
constexpr double LongestAnswer = 0.1;    // of a program that is asked for its field
constexpr double BetweenAnswers = 0.05;  // a program may tell of the focus later than it takes keys
constexpr int MostAnswers = 4;

constexpr const char* WindowLost = "The window that it was for is gone, or does not take the keyboard.";
constexpr const char* FieldLost = "Another field has the focus than the one that it was for.";

}  // namespace

FormBridge::FormBridge(FormView::Id id, std::shared_ptr<SnippetExpandedContent> content, Target& target,
                       Dependencies dependencies)
    : id_(id),
      content_(std::move(content)),
      target_(target),
      around_(std::move(dependencies)),
      keyboard_(around_.processManager, around_.tapLoop),
      owner_(keyboard_.owner()),
      caret_(around_.accessibility, around_.processManager, around_.tapLoop),
      keyInDoubt_(around_.tapLoop, [this] { holdUserKeys(LongestDoubt); }),
      keys_(around_.inputService.keyDownEvent.addObserver(this, &FormBridge::keyPressed)),
      shortcuts_(around_.inputService.unregisteredHotKeyPressedEvent.addObserver(this, &FormBridge::shortcutPressed)) {
    holdUserKeys(LongestOpening);
    askForField([this](const std::string& field) { field_ = field; });
    onView([id, shown = content_, events = events()](FormView& view) { view.prepare(id, shown, events); });
}

FormBridge::~FormBridge() {
    *self_ = nullptr;
    onView([id = id_](FormView& view) { view.close(id); });
}

FormView::Events FormBridge::events() const {
    // On the main thread; what they do is done on this one.
    const auto onTap = [self = self_, &loop = around_.tapLoop](auto call) {
        loop.perform([self, call] {
            if (*self) call(**self);
        });
    };
    return {.shown = [onTap](std::uint32_t window) { onTap([window](FormBridge& bridge) { bridge.shown(window); }); },
            .lost = [onTap] { onTap([](FormBridge& bridge) { bridge.lost(); }); },
            .accepted = [onTap] { onTap([](FormBridge& bridge) { bridge.accepted(); }); },
            .cancelled = [onTap] { onTap([](FormBridge& bridge) { bridge.cancelled(); }); },
            .stayed = [onTap] { onTap([](FormBridge& bridge) { bridge.stayed(); }); }};
}

void FormBridge::onView(std::function<void(FormView&)> call) const {
    around_.mainLoop.perform([view = around_.view, call = std::move(call)] { call(view()); });
}

void FormBridge::holdUserKeys(double seconds) {
    hold_ = around_.inputService.holdUserKeys(seconds);
}

void FormBridge::show() {
    caret_.find(
        [this](const CaretPlace& place) { onView([id = id_, place](FormView& view) { view.show(id, place); }); });
}

void FormBridge::shown(std::uint32_t window) {
    window_ = window;
    keyboard_.giveTo(window, [this](bool) { hold_ = nullptr; });
}

void FormBridge::lost() {
    window_ = 0;
    holdUserKeys(LongestOpening);
}

void FormBridge::mayEnd(const ZDKeyEventArgs& key) {
    const bool isEnd = key.key == KeyCode::Return || key.key == KeyCode::KeypadEnter || key.key == KeyCode::Escape;
    keyInDoubt_.keyPressed(isEnd && keyboard_.hasKeyboard(window_));
}

void FormBridge::stayed() {
    keyInDoubt_.end();
    hold_ = nullptr;
}

void FormBridge::accepted() {
    keyInDoubt_.end();
    window_ = 0;
    holdUserKeys(LongestClosing);
    keyboard_.giveBackTo(owner_, [this](bool isBack) {
        if (!isBack) return keep(WindowLost);
        // The user has looked where the text goes when it is tried once more.
        if (isKept_ || field_.empty()) return send();
        checkField(MostAnswers);
    });
}

void FormBridge::cancelled() {
    keyInDoubt_.end();
    window_ = 0;
    if (isKept_) return target_.fieldsEditorWillClose(*this);
    holdUserKeys(LongestDoubt);
    keyboard_.giveBackTo(owner_, [this](bool) { target_.fieldsEditorWillClose(*this); });
}

void FormBridge::askForField(std::function<void(const std::string& field)> told) {
    asked_ = std::make_shared<std::function<void(const std::string&)>>(std::move(told));
    const auto answer = [this](const std::string& field) {
        checking_.cancel();
        const auto asked = std::exchange(asked_, nullptr);
        (*asked)(field);
    };
    checking_ = around_.tapLoop.performAfterDelay(LongestAnswer, [answer] { answer({}); });
    around_.accessibility.askForFocusedPlaces(
        [answer, asked = std::weak_ptr(asked_), &loop = around_.tapLoop](const FocusedPlaces& places) {
            loop.perform([answer, asked, field = places.elementName] {
                if (!asked.expired()) answer(field);
            });
        });
}

void FormBridge::checkField(int attemptsLeft) {
    askForField([this, attemptsLeft](const std::string& field) {
        if (field.empty() || field == field_) return send();
        if (attemptsLeft == 0) return keep(FieldLost);
        checking_ =
            around_.tapLoop.performAfterDelay(BetweenAnswers, [this, attemptsLeft] { checkField(attemptsLeft - 1); });
    });
}

void FormBridge::send() {
    target_.fieldsEditorWillClose(*this);
    target_.fieldsEditorAction(*this);
    // Behind the text: while that is on its way, keys are kept back for it.
    hold_ = nullptr;
}

void FormBridge::keep(const std::string& reason) {
    isKept_ = true;
    hold_ = nullptr;
    onView([id = id_, reason](FormView& view) { view.keepUnsent(id, reason); });
}

}  // namespace plume
