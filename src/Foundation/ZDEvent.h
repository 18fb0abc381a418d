// A multicast event: components announce things through one, listeners are called in the order they registered.
//
// Owned by the component that raises it. Observers are not owned: each keeps the subscription that it was given, and is
// not called once that is gone. Registering, removing and raising happen on one thread, the event's own. A handler
// may add and remove handlers, itself included, while the event is raised: a removed one is not called any more, an
// added one is called from the next raise on.
#pragma once

#include <algorithm>
#include <cstddef>
#include <functional>
#include <memory>
#include <vector>

#include "Foundation/Subscription.h"

namespace plume {

template <typename Argument>
class ZDEvent {
  public:
    // Hands a call to the main thread and does not wait for it.
    using Post = std::function<void(std::function<void()>)>;

    ZDEvent() = default;
    ZDEvent(const ZDEvent&) = delete;
    ZDEvent& operator=(const ZDEvent&) = delete;

    // `selector` is an operation of the observer that takes the argument.
    template <typename Observer>
    [[nodiscard]] Subscription addObserver(Observer* observer, void (Observer::*selector)(Argument&)) {
        const auto handler = std::make_shared<MemberHandler<Observer>>(observer, selector);
        handlers_.push_back(handler);
        return Subscription(std::shared_ptr<bool>(handler, &handler->removed));
    }

    // Removes the first handler with this observer and this operation, if there is one.
    template <typename Observer>
    void removeObserver(Observer* observer, void (Observer::*selector)(Argument&)) {
        const auto found = std::find_if(handlers_.begin(), handlers_.end(), [&](const auto& handler) {
            const auto* member = dynamic_cast<const MemberHandler<Observer>*>(handler.get());
            return !handler->removed && member && member->target == observer && member->selector == selector;
        });
        if (found != handlers_.end()) (*found)->removed = true;
        dropRemoved();
    }

    bool isObserved() const {
        return std::any_of(handlers_.begin(), handlers_.end(), [](const auto& handler) { return !handler->removed; });
    }

    // Calls every handler, on the caller's thread. Allocates nothing.
    void raise(Argument& argument) {
        ++raising_;
        const std::size_t count = handlers_.size();
        for (std::size_t i = 0; i < count; ++i) {
            const auto handler = handlers_[i];
            if (!handler->removed) handler->call(argument);
        }
        --raising_;
        dropRemoved();
    }

    // Queues one call per handler on the main thread; the argument lives until the last of them has returned. A handler
    // removed before its call arrives is not called.
    void raiseOnMainThread(const std::shared_ptr<Argument>& argument, const Post& post) {
        for (const auto& handler : handlers_) {
            post([handler, argument] {
                if (!handler->removed) handler->call(*argument);
            });
        }
    }

  private:
    struct ZDEventHandler {
        explicit ZDEventHandler(const void* anObserver) : observer(anObserver) {}
        virtual ~ZDEventHandler() = default;
        virtual void call(Argument& argument) const = 0;

        const void* observer;
        bool removed = false;
    };

    template <typename Observer>
    struct MemberHandler final : ZDEventHandler {
        using Selector = void (Observer::*)(Argument&);
        MemberHandler(Observer* aTarget, Selector aSelector)
            : ZDEventHandler(aTarget), target(aTarget), selector(aSelector) {}
        void call(Argument& argument) const override { (target->*selector)(argument); }

        Observer* target;
        Selector selector;
    };

    // While the event is raised the list keeps its places; what was removed goes when the outermost raise is over.
    void dropRemoved() {
        if (raising_ > 0) return;
        std::erase_if(handlers_, [](const auto& handler) { return handler->removed; });
    }

    std::vector<std::shared_ptr<ZDEventHandler>> handlers_;
    int raising_ = 0;
};

}  // namespace plume
