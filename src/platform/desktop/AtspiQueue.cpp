#include "platform/desktop/AtspiQueue.h"

namespace plume {

using std::chrono::steady_clock;

AtspiQueue::AtspiQueue() : context_(g_main_context_new()) {}

AtspiQueue::~AtspiQueue() {
    g_main_context_unref(context_);
}

void AtspiQueue::run(const Call& afterEach) {
    while (!ended_) {
        g_main_context_iteration(context_, TRUE);
        afterEach();
    }
}

AtspiPart AtspiQueue::share(AtspiAccessible* part) {
    if (part == nullptr) return nullptr;
    return {part, [queue = shared_from_this()](AtspiAccessible* shared) {
                // Only libatspi's own thread may let go of it; what is left when that has ended goes with the process.
                if (!queue->hasEnded()) queue->post([shared] { g_object_unref(shared); });
            }};
}

void AtspiQueue::post(Call call) {
    attach(g_idle_source_new(), std::move(call));
}

void AtspiQueue::postAfter(std::chrono::milliseconds delay, Call call) {
    attach(g_timeout_source_new(static_cast<guint>(delay.count())), std::move(call));
}

// Not g_main_context_invoke(): between two turns of the thread it would run the call on this one.
void AtspiQueue::attach(GSource* source, Call call) {
    g_source_set_priority(source, G_PRIORITY_DEFAULT);
    g_source_set_callback(
        source,
        [](void* posted) {
            (*static_cast<Call*>(posted))();
            return G_SOURCE_REMOVE;
        },
        new Call(std::move(call)), [](void* posted) { delete static_cast<Call*>(posted); });
    g_source_attach(source, context_);
    g_source_unref(source);
}

void AtspiQueue::end() {
    ended_ = true;
    g_main_context_wakeup(context_);
}

bool AtspiQueue::answersAreExpected() const {
    return open_ && !ended_ && steady_clock::now().time_since_epoch().count() >= pausedUntil_;
}

void AtspiQueue::expectNoAnswers() {
    pausedUntil_ = (steady_clock::now() + Pause).time_since_epoch().count();
}

}  // namespace plume
