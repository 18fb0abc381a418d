// Functions that want to be called when something has happened, and the calling of them.
//
// Belongs to one thread. A function may add and end subscriptions, its own included, while it is called: one that has
// ended is not called any more, one that was added is called from the next time on.
#pragma once

#include <algorithm>
#include <functional>
#include <memory>
#include <utility>
#include <vector>

#include "Foundation/Subscription.h"

namespace plume {

class Observers {
  public:
    using Call = std::function<void()>;

    [[nodiscard]] Subscription add(Call call) {
        dropEnded();
        const auto observer = std::make_shared<Observer>(Observer{.call = std::move(call)});
        observers_.push_back(observer);
        return Subscription(std::shared_ptr<bool>(observer, &observer->ended));
    }

    void call() {
        dropEnded();
        for (const auto& observer : std::vector(observers_)) {
            if (!observer->ended) observer->call();
        }
    }

    bool empty() const {
        return std::all_of(observers_.begin(), observers_.end(), [](const auto& observer) { return observer->ended; });
    }

  private:
    struct Observer {
        Call call;
        bool ended = false;
    };

    void dropEnded() {
        std::erase_if(observers_, [](const auto& observer) { return observer->ended; });
    }

    std::vector<std::shared_ptr<Observer>> observers_;
};

}  // namespace plume
