#include "testing/rig/DesktopRig.h"

namespace plume::rig {

namespace {

constexpr int KeyTries = 3;
constexpr Milliseconds KeyBound(5'000);

template <typename Attempt>
bool tryTimes(int times, const Attempt& attempt) {
    for (int i = 0; i < times; ++i)
        if (attempt()) return true;
    return false;
}

}  // namespace

DesktopRig::DesktopRig(const XServer::Options& options, WindowManager manager)
    : server_(directory_, options, privateEnvironment(directory_)),
      session_(directory_, server_, manager),
      client_(server_.display()),
      keyboard_(server_.keyboardSocket(), options),
      pointer_(server_.pointerSocket(), options) {}

std::unique_ptr<TargetProgram> DesktopRig::startTarget(TargetKind kind) {
    const auto socket = directory_.path() / ("target" + std::to_string(++targets_));
    auto target = std::make_unique<TargetProgram>(kind, session_, client_, socket);
    // A window that has the focus for the server does not have it for its toolkit yet, which may cost the first keys.
    // Once one has become text, all that was sent before it has been dealt with.
    if (!tryTimes(KeyTries, [&] {
            keyboard_.type("x");
            return !target->awaitText("x", KeyBound).empty();
        }))
        throw RigError("the " + nameOf(kind) + " target takes no keys");
    if (!tryTimes(KeyTries, [&] {
            keyboard_.tap(Key::Backspace);
            return target->awaitText("", KeyBound).empty();
        }))
        throw RigError("the " + nameOf(kind) + " target takes no Backspace");
    target->forgetReports();
    return target;
}

void DesktopRig::click(int x, int y, int button) {
    pointer_.moveTo(x, y);
    pointer_.press(button);
    pointer_.release(button);
    pointer_.sync();
    client_.await("a click", Milliseconds(5'000), [this] { return !client_.isButtonDown(); });
}

}  // namespace plume::rig
