#include "app/QuickSearchBridge.h"

#include <algorithm>
#include <array>
#include <utility>

namespace plume {

namespace {

// The release of a key is kept back, too: one that seemed held for longer would begin to repeat.
constexpr double LongestHold = 0.3;  // seconds

constexpr std::array DigitKeys{KeyCode::Digit1, KeyCode::Digit2, KeyCode::Digit3, KeyCode::Digit4, KeyCode::Digit5,
                               KeyCode::Digit6, KeyCode::Digit7, KeyCode::Digit8, KeyCode::Digit9, KeyCode::Digit0};

bool mayEndSearch(const ZDKeyEventArgs& key) {
    const bool isDigit = (key.c >= u'0' && key.c <= u'9') || std::ranges::count(DigitKeys, key.key) > 0;
    return isDigit || key.key == KeyCode::Return || key.key == KeyCode::KeypadEnter || key.key == KeyCode::Escape;
}

}  // namespace

QuickSearchBridge::QuickSearchBridge(Dependencies dependencies)
    : around_(std::move(dependencies)),
      keyboard_(around_.processManager, around_.tapLoop),
      caret_(around_.accessibility, around_.processManager, around_.tapLoop),
      keyInDoubt_(around_.tapLoop, [this] { hold_ = around_.holdUserKeys(LongestHold); }) {
    around_.mainLoop.perform([view = around_.view, events = events()] { view().setEvents(events); });
}

QuickSearchBridge::~QuickSearchBridge() {
    *self_ = nullptr;
    around_.mainLoop.perform([view = around_.view] {
        view().close();
        view().setEvents({});
    });
}

QuickSearchView::Events QuickSearchBridge::events() const {
    // On the main thread; what they do is done on this one.
    const auto onTap = [self = self_, &loop = around_.tapLoop](auto call) {
        loop.perform([self, call] {
            if (*self) call(**self);
        });
    };
    return {.shown =
                [onTap](std::uint32_t window) { onTap([window](QuickSearchBridge& bridge) { bridge.shown(window); }); },
            .placed =
                [onTap](const Rectangle& frame) {
                    onTap([frame](QuickSearchBridge& bridge) {
                        if (bridge.visible_) bridge.frame_ = frame;
                    });
                },
            .closed = [onTap] { onTap([](QuickSearchBridge& bridge) { bridge.closedByUser(); }); },
            .replaced = [onTap] { onTap([](QuickSearchBridge& bridge) { bridge.replaced(); }); },
            .stayed = [onTap] { onTap([](QuickSearchBridge& bridge) { bridge.stayed(); }); }};
}

void QuickSearchBridge::open(bool atCaret) {
    // What was chosen last is still on its way, and comes first.
    if (selected_) return;
    // One that is moved to the corner still sends to where it was opened.
    if (!visible_) {
        keyboard_.cancel();
        // Closed a moment ago, it may have the keyboard itself.
        if (!hasKeyboard()) target_ = keyboard_.owner();
        const std::u16string query = around_.typedQuery();
        typedText_ = query.empty() ? std::nullopt : std::optional(query);
        hold_ = around_.holdUserKeys(LongestHold);
    }
    visible_ = true;
    firstRows_.clear();
    caret_.cancel();
    if (!atCaret) return openWindow(std::nullopt);
    caret_.find([this](const CaretPlace& place) { openWindow(place); });
}

void QuickSearchBridge::openWindow(const std::optional<CaretPlace>& place) {
    const QuickSearchOpening opening{
        .place = place, .query = typedText_.value_or(u""), .selectorKeyModifier = selectorKeyModifier_};
    around_.mainLoop.perform([view = around_.view, opening] { view().show(opening); });
}

void QuickSearchBridge::shown(std::uint32_t window) {
    if (!visible_) return;
    ownWindow_ = window;
    keyboard_.giveTo(window, [this](bool) { hold_ = nullptr; });
}

void QuickSearchBridge::close() {
    caret_.cancel();
    keyboard_.cancel();
    keyInDoubt_.end();
    hold_ = nullptr;
    frame_ = {};
    if (std::exchange(visible_, false)) around_.mainLoop.perform([view = around_.view] { view().close(); });
}

// The keyboard goes back to where it came from, if the window manager does not know that by itself.
void QuickSearchBridge::closedByUser() {
    if (!std::exchange(visible_, false)) return;
    keyInDoubt_.end();
    frame_ = {};
    hold_ = around_.holdUserKeys(LongestHold);
    keyboard_.giveBackTo(target_, [this](bool) { hold_ = nullptr; });
}

void QuickSearchBridge::replaced() {
    stayed();
    visible_ = false;
    frame_ = {};
}

// The window that has the keyboard is one that digits are typed into.
std::shared_ptr<Snippet> QuickSearchBridge::snippetAtIndex(std::size_t index) const {
    if (index >= firstRows_.size() || hasKeyboard()) return nullptr;
    return firstRows_[index];
}

void QuickSearchBridge::keyPressed(ZDKeyEventArgs& key) {
    keyInDoubt_.keyPressed(mayEndSearch(key) && isSearching());
}

void QuickSearchBridge::shortcutPressed(ZDUnregisteredHotKeyPressedEventArgs& key) {
    const bool mayEnd = mayEndSearch(key) || key.key == KeyCode::E || key.key == KeyCode::W;
    keyInDoubt_.keyPressed(mayEnd && isSearching());
}

void QuickSearchBridge::stayed() {
    keyInDoubt_.end();
    hold_ = nullptr;
}

void QuickSearchBridge::choose(std::shared_ptr<Snippet> snippet) {
    if (!snippet) around_.report("The snippet was not sent: it is no longer in your library.");
    if (!snippet) return closedByUser();
    if (!std::exchange(visible_, false)) return;
    keyInDoubt_.end();
    frame_ = {};
    selected_ = std::move(snippet);
    hold_ = around_.holdUserKeys(LongestHold);
    keyboard_.giveBackTo(target_, [this](bool isBack) { send(isBack); });
}

void QuickSearchBridge::send(bool targetIsBack) {
    if (targetIsBack) {
        selectedAction_();
    } else {
        around_.report("The snippet was not sent: the window that it was for is gone, or does not take the keyboard.");
    }
    selected_ = nullptr;
    // Behind the snippet: while that is on its way, keys are kept back for it.
    hold_ = nullptr;
}

}  // namespace plume
