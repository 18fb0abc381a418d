#include "ports/atspi/AtspiFocusTracker.h"

#include <algorithm>
#include <array>
#include <string_view>
#include <utility>

#include "ports/atspi/AtspiText.h"

namespace plume {

namespace {

using std::chrono::milliseconds;

constexpr milliseconds UsualPause{250};
constexpr milliseconds PauseAfterSilence{1'000};
constexpr milliseconds PauseWithoutBus{5'000};
// A program that tells nothing is asked ever more rarely.
constexpr std::array PausesAfterNothing = {milliseconds(500), milliseconds(1'000), milliseconds(2'000),
                                           milliseconds(5'000)};
// Programs move their focus some time after the click or the key that makes them do it. From one look to the next.
constexpr std::array TimesBetweenLooks = {0.015, 0.045, 0.190, 0.750};
// While somebody only types; there is a look every so often then.
constexpr milliseconds Fresh{300};
constexpr milliseconds FreshWhileMoving{50};
constexpr milliseconds FreshWhileUnknown{20};  // a program that has just come to the front
constexpr milliseconds LookBound{1'000};
constexpr milliseconds LongestWait{50};
// An answer to a question that was asked so long after a key is none of before it.
constexpr milliseconds KeyOnItsWay{10};
// A program may take as long to move its focus as it was told to.
constexpr milliseconds ExpectedMove{1'000};
constexpr double TimeAfterTyping = 0.5;

// Those of which every text is found by walking.
bool isWalkedThrough(std::string_view toolkit) {
    return toolkit == "gtk" || toolkit == "GTK" || toolkit == "Qt";
}

AtspiFocus::Kind kindOf(AtspiBus& bus, const AtspiPart& part, AtspiRole role) {
    if (role == AtspiRole::PasswordText) return AtspiFocus::Kind::Password;
    if (role == AtspiRole::Terminal) return AtspiFocus::Kind::Lines;
    if (role != AtspiRole::Entry && role != AtspiRole::Text) return AtspiFocus::Kind::Unknown;
    const auto states = statesOf(bus, part);
    if (!states || !states->has(AtspiState::Editable)) return AtspiFocus::Kind::Unknown;
    return states->has(AtspiState::MultiLine) ? AtspiFocus::Kind::Lines : AtspiFocus::Kind::Line;
}

}  // namespace

AtspiFocusTracker::AtspiFocusTracker(PollRunLoop& loop, AtspiBus& bus, BusAddressSource address)
    : loop_(loop),
      bus_(bus),
      address_(std::move(address)),
      finder_(bus),
      listener_(loop, [this](const AtspiPart& part) { heardFocus(part); }) {}

void AtspiFocusTracker::setFrontProcess(pid_t process) {
    if (!focus_.setFront(process)) return;
    programTells_ = false;
    firstLook_.owe();
    loop_.perform([this] {
        listener_.stop();
        lookSeveralTimes();
        look();
    });
}

void AtspiFocusTracker::focusMayHaveMoved() {
    expectMove();
    loop_.perform([this] { lookSeveralTimes(); });
}

void AtspiFocusTracker::expectMove() {
    expectedUntil_ = (Clock::now() + ExpectedMove).time_since_epoch().count();
}

bool AtspiFocusTracker::isMoveExpected() const {
    return Clock::now().time_since_epoch().count() < expectedUntil_;
}

void AtspiFocusTracker::userMovesFocus(FocusMover mover) {
    focusMayHaveMoved();
    const bool staysInText = mover == FocusMover::Return && focus_.isLines();
    if (!programTells_ || staysInText) return;
    movedAt_ = Clock::now().time_since_epoch().count();
    moved_.owe();
}

void AtspiFocusTracker::userTypes() {
    const Clock::rep now = Clock::now().time_since_epoch().count();
    Clock::rep next = nextLook_.load(std::memory_order_relaxed);
    if (now < next) return;
    const Clock::rep later = now + Clock::duration(UsualPause).count();
    if (!nextLook_.compare_exchange_strong(next, later, std::memory_order_relaxed)) return;
    loop_.perform([this] {
        look();
        lookAfterTyping();
    });
}

// What a program does with its focus when a text is complete, it does behind the last key.
void AtspiFocusTracker::lookAfterTyping() {
    if (!focus_.isKnown()) return;
    afterTyping_ = loop_.performAfterDelay(TimeAfterTyping, [this] { look(); });
}

// Who asks mostly wants to know of a selection next: both questions take the way to the program together.
AtspiFocused AtspiFocusTracker::focusedNow() {
    const AtspiPart known = focus_.part();
    AtspiPendingCall selections = AtspiTextReader::askForSelections(bus_, known);
    const milliseconds freshWhileMoving = known ? FreshWhileMoving : FreshWhileUnknown;
    if (Clock::now() - lookedAt_ > (isMoveExpected() ? freshWhileMoving : Fresh)) look();
    const bool isStill = known && focus_.part() == known;
    return focus_.tell(known,
                       isStill ? AtspiTextReader::selectsNothing(bus_, known, std::move(selections)) : std::nullopt);
}

void AtspiFocusTracker::lookSeveralTimes() {
    misses_ = 0;
    lookAfter(0);
}

void AtspiFocusTracker::lookAfter(std::size_t step) {
    nextOfSeries_ = loop_.performAfterDelay(TimesBetweenLooks.at(step), [this, step] {
        nextOfSeries_.cancel();
        if (step + 1 < TimesBetweenLooks.size()) lookAfter(step + 1);
        look();
    });
}

void AtspiFocusTracker::awaitAnswers() {
    firstLook_.await(LongestWait);
    if (!moved_.isOwed()) return;
    const Clock::duration since = Clock::now().time_since_epoch() - Clock::duration(movedAt_);
    moved_.await(std::chrono::ceil<milliseconds>(std::max(LongestWait - since, Clock::duration::zero())));
}

void AtspiFocusTracker::look() {
    const AtspiFocus::Front front = focus_.front();
    const AtspiPart before = focus_.part();
    lookAt(front);
    if (front.turn == focus_.front().turn) firstLook_.give();
    // Who is listened to has moved its focus when it says so: its answers may be older.
    const bool answersKey = !listener_.isListening() && !bus_.leftUnanswered() &&
                            lookedAt_.time_since_epoch() >= Clock::duration(movedAt_) + KeyOnItsWay;
    if (answersKey || (focus_.isKnown() && focus_.part() != before)) moved_.give();
}

void AtspiFocusTracker::heardFocus(const AtspiPart& part) {
    bus_.begin(LookBound);
    const bool isAnother = part != focus_.part();  // or it tells of what was before the key
    becomeFocused(listenedFront_, part, listenedProcess_);
    if (isAnother) moved_.give();
}

void AtspiFocusTracker::lookAt(const AtspiFocus::Front& front) {
    lookedAt_ = Clock::now();
    if (address_() == nullptr) return setPause(PauseWithoutBus);
    bus_.begin(LookBound);
    const AtspiPart known = connection_ == bus_.connections() ? focus_.part() : AtspiPart();
    if (known && hasState(bus_, known, AtspiState::Focused)) {
        programTells_ = true;
        return setPause(UsualPause);
    }
    // What is known stays: a password above all, until the program shows something else.
    if (known && bus_.leftUnanswered()) {
        programTells_ = false;
        return setPause(PauseAfterSilence);
    }
    search(front);
}

void AtspiFocusTracker::search(const AtspiFocus::Front& front) {
    const AtspiFocusFinder::Found found = finder_.find(front.process);
    if (found.part) {
        becomeFocused(front, found.part, found.process);
    } else if (bus_.leftUnanswered()) {
        setPause(PauseAfterSilence);
    } else {
        focus_.forget(front);
        setPause(PausesAfterNothing.at(std::min(misses_, PausesAfterNothing.size() - 1)));
        if (!nextOfSeries_) ++misses_;
    }
    listenWhereItHelps(front, found);
    programTells_ = !bus_.leftUnanswered() && (found.part || listener_.isListening());
}

void AtspiFocusTracker::becomeFocused(const AtspiFocus::Front& front, const AtspiPart& part, pid_t process) {
    const auto role = roleNumberOf(bus_, part);
    if (!role) return setPause(PauseAfterSilence);
    connection_ = bus_.connections();
    focus_.set(front, part, kindOf(bus_, part, *role), process, isMoveExpected());
    misses_ = 0;
    setPause(UsualPause);
}

void AtspiFocusTracker::listenWhereItHelps(const AtspiFocus::Front& front, const AtspiFocusFinder::Found& found) {
    if (found.program.empty()) return;
    const std::string& toolkit = finder_.toolkitOf(found.program);
    if (toolkit.empty()) return;  // one of those that are slow to answer must not become slower
    if (isWalkedThrough(toolkit)) return listener_.stop();
    const std::string* address = address_();
    if (address == nullptr) return;
    listenedFront_ = front;
    listenedProcess_ = found.process;
    listener_.listenTo(found.program, *address);
    if (!found.part) finder_.askForParts(found.program);
}

void AtspiFocusTracker::setPause(milliseconds pause) {
    nextLook_.store((Clock::now() + pause).time_since_epoch().count(), std::memory_order_relaxed);
}

}  // namespace plume
