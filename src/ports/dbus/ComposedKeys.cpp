#include "ports/dbus/ComposedKeys.h"

#include <algorithm>

namespace plume {

namespace {

constexpr std::chrono::milliseconds ForText{100};
constexpr std::chrono::milliseconds ForSlowEngine{300};  // more
constexpr std::chrono::milliseconds ForNothing{20};

}  // namespace

void ComposedKeys::announceKey(std::uint32_t code, bool typesNothing) {
    typesNothing_ = typesNothing;
    longestWait_ = std::chrono::steady_clock::now() + (typesNothing ? ForNothing : ForText);
    const std::scoped_lock lock(mutex_);
    announced_ = code;
    current_.reset();
    idle_ = false;
    owed_.owe();
}

void ComposedKeys::settle() {
    using std::chrono::milliseconds;
    const auto left = longestWait_ - std::chrono::steady_clock::now();
    owed_.await(std::max(milliseconds(0), std::chrono::ceil<milliseconds>(left)));
    if (engineIsSlow()) owed_.await(ForSlowEngine);
    const std::scoped_lock lock(mutex_);
    if (!announced_) return;
    announced_.reset();
    // Menus and shortcuts take such keys before any engine.
    if (typesNothing_) return current_.reset();
    // The program did not give it to an engine: keys are just keys until one is heard of again.
    if (!current_) takesText_ = false;
    current_.reset();
    Outcome nobodyKnows;
    nobodyKnows.unknown = true;
    outcomes_.push_back(std::move(nobodyKnows));
}

// It has the key. Other keys would wait in its program if not here.
bool ComposedKeys::engineIsSlow() {
    const std::scoped_lock lock(mutex_);
    const bool isSlow = announced_ && current_ && !typesNothing_;
    if (isSlow) owed_.owe();
    return isSlow;
}

std::optional<InputMethod::Outcome> ComposedKeys::next() {
    const std::scoped_lock lock(mutex_);
    if (outcomes_.empty()) {
        idle_ = !announced_;
        return std::nullopt;
    }
    Outcome first = std::move(outcomes_.front());
    outcomes_.pop_front();
    return first;
}

void ComposedKeys::setTakesText(bool takes) {
    takesText_ = takes;
    if (!takes) composing_ = false;
}

bool ComposedKeys::beginsWith(std::uint32_t code) {
    const std::scoped_lock lock(mutex_);
    if (announced_ != code || current_) return false;
    current_.emplace();
    return true;
}

void ComposedKeys::put(const std::u16string& text) {
    const std::scoped_lock lock(mutex_);
    if (current_) {
        current_->text += text;
    } else {
        Outcome outcome;
        outcome.text = text;
        push(std::move(outcome));
    }
}

void ComposedKeys::erase(std::size_t characters) {
    constexpr std::size_t Longest = 100;  // no abbreviation reaches as far
    const std::scoped_lock lock(mutex_);
    if (!current_) return;
    // In another order nobody knows what stands there.
    if (!current_->text.empty() || characters > Longest - current_->erased) current_->unknown = true;
    if (!current_->unknown) current_->erased += characters;
}

void ComposedKeys::passKey() {
    const std::scoped_lock lock(mutex_);
    if (current_) current_->keyPassed = true;
}

void ComposedKeys::end() {
    {
        const std::scoped_lock lock(mutex_);
        if (!current_) return;
        announced_.reset();
        push(*std::exchange(current_, std::nullopt));
    }
    owed_.give();
}

void ComposedKeys::push(Outcome outcome) {
    outcome.composing = composing_;
    outcomes_.push_back(std::move(outcome));
    idle_ = false;
    if (happened) happened();
}

}  // namespace plume
