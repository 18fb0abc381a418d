#include "app/form/helper/PageLink.h"

#include <utility>

namespace plume {

void PageLink::update(const QJsonObject& changes) {
    if (isLinked_) {
        Q_EMIT updated(changes);
    } else {
        waiting_.push_back(changes);
    }
}

// A page is measured before it appears, so that it listens by then.
void PageLink::appear() {
    Q_EMIT appears();
}

void PageLink::linked() {
    isLinked_ = true;
    for (const QJsonObject& changes : std::exchange(waiting_, {})) Q_EMIT updated(changes);
}

void PageLink::filled(int field, const QString& value, int choice, bool isUnreadable) const {
    events_.filled(field, value, choice, isUnreadable);
}

}  // namespace plume
