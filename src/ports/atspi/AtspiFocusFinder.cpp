#include "ports/atspi/AtspiFocusFinder.h"

#include <algorithm>

namespace plume {

namespace {

constexpr int DeepestPart = 40;
constexpr int MostPartsSearched = 400;
constexpr int MostChildren = 100;
constexpr int MostPrograms = 1'000;

constexpr const char* EventInterface = "org.a11y.atspi.Event.Object";
constexpr std::chrono::milliseconds StartBound{450};

}  // namespace

AtspiFocusFinder::Found AtspiFocusFinder::find(pid_t process) {
    updatePrograms();
    const auto isOfProcess = [&](const Program& program) { return process != 0 && program.process == process; };
    const bool isOnTheBus = std::ranges::any_of(programs_, isOfProcess);
    Found found;
    for (const Program& program : programs_) {
        if ((!isOnTheBus || isOfProcess(program)) && findIn(program, isOnTheBus, found)) break;
    }
    return found;
}

const std::string& AtspiFocusFinder::toolkitOf(const std::string& program) {
    static const std::string none;
    const auto found = std::ranges::find(programs_, program, [](const Program& each) { return each.root.program; });
    if (found == programs_.end()) return none;
    if (!found->toldToolkit) {
        const BusAnswer answer = bus_.property(found->root, "org.a11y.atspi.Application", "ToolkitName");
        found->toldToolkit = static_cast<bool>(answer);
        found->toolkit = answer.values().inside().string().value_or("");
    }
    return found->toolkit;
}

void AtspiFocusFinder::askForParts(const std::string& program) {
    const auto found = std::ranges::find(programs_, program, [](const Program& each) { return each.root.program; });
    if (found == programs_.end()) return;
    for (const AtspiPart& window : childrenOf(bus_, found->root, MostChildren)) {
        bus_.call(window, AccessibleInterface, "GetRelationSet");
    }
}

void AtspiFocusFinder::updatePrograms() {
    if (std::exchange(connection_, bus_.connections()) != bus_.connections()) programs_.clear();
    const AtspiPart desktop{"org.a11y.atspi.Registry", "/org/a11y/atspi/accessible/root"};
    std::vector<Program> programs;
    for (const AtspiPart& root : childrenOf(bus_, desktop, MostPrograms)) programs.push_back(programAt(root));
    if (!programs.empty() || !bus_.leftUnanswered()) programs_ = std::move(programs);
}

// The name of a connection is never given to another one, so what is known of it stays right.
AtspiFocusFinder::Program AtspiFocusFinder::programAt(const AtspiPart& root) {
    const auto known = std::ranges::find(programs_, root, &Program::root);
    if (known != programs_.end() && known->process != 0) return *known;
    const auto process = bus_.callBus("GetConnectionUnixProcessID", {root.program}).values().uint32();
    return {root, static_cast<pid_t>(process.value_or(0)), {}, false};
}

bool AtspiFocusFinder::findIn(const Program& program, bool isInFront, Found& found) {
    if (isInFront) found = {{}, program.root.program, program.process};
    for (const AtspiPart& window : childrenOf(bus_, program.root, MostChildren)) {
        const auto states = statesOf(bus_, window);
        if (!states || !states->has(AtspiState::Active)) continue;
        int left = MostPartsSearched;
        found = {focusedBelow(window, *states, 0, left), program.root.program, program.process};
        if (found.part) return true;
    }
    return false;
}

AtspiPart AtspiFocusFinder::focusedBelow(const AtspiPart& part, const AtspiStates& states, int depth, int& left) {
    // A text can be a window by itself; other windows only stand for what they hold.
    if (states.has(AtspiState::Focused) && (depth > 0 || states.has(AtspiState::Editable))) return part;
    if (depth == DeepestPart || states.has(AtspiState::ManagesDescendants)) return {};
    if (depth > 0 && !states.has(AtspiState::Showing)) return {};
    for (const AtspiPart& child : childrenOf(bus_, part, MostChildren)) {
        if (--left < 0) return {};
        const auto childStates = statesOf(bus_, child);
        if (!childStates) continue;
        if (AtspiPart found = focusedBelow(child, *childStates, depth + 1, left)) return found;
    }
    return {};
}

void AtspiFocusListener::listenTo(const std::string& program, const std::string& address) {
    if (program_ == program) return;
    stop();
    if (!begin(program, address)) return bus_.disconnect();
    program_ = program;
    source_ = loop_.addSource(bus_.descriptor(), [this] { takeMessages(); });
}

void AtspiFocusListener::stop() {
    if (program_.empty()) return;
    source_.end();
    bus_.disconnect();
    program_.clear();
}

bool AtspiFocusListener::begin(const std::string& program, const std::string& address) {
    if (!bus_.connect(address)) return false;
    bus_.begin(StartBound);
    const std::string rule = std::string("type='signal',interface='") + EventInterface +
                             "',member='StateChanged',arg0='focused',sender='" + program + "'";
    const AtspiPart registry{"org.a11y.atspi.Registry", "/org/a11y/atspi/registry"};
    return bus_.callBus("AddMatch", {rule}) &&
           bus_.call(registry, "org.a11y.atspi.Registry", "RegisterEvent", {"object:state-changed:focused"});
}

void AtspiFocusListener::takeMessages() {
    while (const BusMessage message = bus_.takeMessage()) take(message.get());
    if (!bus_.isConnected()) stop();
}

void AtspiFocusListener::take(DBusMessage* message) const {
    if (dbus_message_is_signal(message, EventInterface, "StateChanged") == 0) return;
    BusReader values(message);
    const auto state = values.string();
    const auto gained = values.int32();
    const char* path = dbus_message_get_path(message);
    if (state == "focused" && gained == 1 && path != nullptr) heard_({program_, path});
}

}  // namespace plume
