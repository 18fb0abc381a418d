#include "ports/x11/clipboard/X11SelectionTransfers.h"

#include <algorithm>

namespace plume {

namespace {

constexpr std::size_t UsualPiece = std::size_t{1} << 20;
constexpr std::size_t RoomForTheRequest = 256;
constexpr double LongestIdle = 30;      // seconds
constexpr double PresumedTaking = 0.3;  // seconds
constexpr std::uint32_t RequestorEvents = XCB_EVENT_MASK_PROPERTY_CHANGE | XCB_EVENT_MASK_STRUCTURE_NOTIFY;

std::size_t longestPieceOf(xcb_connection_t* connection) {
    const std::size_t longestRequest = std::size_t{xcb_get_maximum_request_length(connection)} * 4;
    return std::min(UsualPiece, longestRequest - RoomForTheRequest) & ~std::size_t{3};
}

}  // namespace

X11SelectionTransfers::X11SelectionTransfers(X11Session& session)
    : session_(session), longestPiece_(longestPieceOf(session.get())) {
    propertyHandler_ = session_.addHandler(XCB_PROPERTY_NOTIFY, [this](const xcb_generic_event_t& event) {
        const auto& change = reinterpret_cast<const xcb_property_notify_event_t&>(event);
        if (change.state == XCB_PROPERTY_DELETE) propertyWasRemoved({change.window, change.atom}, event.full_sequence);
    });
    destroyHandler_ = session_.addHandler(XCB_DESTROY_NOTIFY, [this](const xcb_generic_event_t& event) {
        forgetWindow(reinterpret_cast<const xcb_destroy_notify_event_t&>(event).window);
    });
    errorHandler_ = session_.addHandler(0, [this](const xcb_generic_event_t& event) {
        const auto& error = reinterpret_cast<const xcb_generic_error_t&>(event);
        if (error.error_code == XCB_WINDOW) forgetWindow(error.resource_id);
    });
}

void X11SelectionTransfers::send(xcb_window_t requestor, xcb_atom_t property, X11SelectionValue value,
                                 std::function<void()> taken) {
    const Key key(requestor, property);
    // Before the value is written: its removal must not be missed.
    Transfer transfer{session_.listen(requestor, RequestorEvents), std::move(value), std::move(taken)};
    // Some ask for something else in the same place before they remove what they have read.
    const auto before = transfers_.find(key);
    const bool wasRead = before != transfers_.end() && before->second.isComplete;
    const auto takenBefore = wasRead ? before->second.taken : nullptr;
    begin(key, transfers_.insert_or_assign(key, std::move(transfer)).first->second);
    if (!nextSweep_) nextSweep_ = session_.runLoop().performAfterDelay(LongestIdle, [this] { forgetIdle(); });
    if (takenBefore) takenBefore();
}

void X11SelectionTransfers::begin(const Key& key, Transfer& transfer) {
    transfer.lastMoved = session_.runLoop().now();
    const std::size_t size = transfer.value.bytes->size();
    transfer.isIncremental = size > longestPiece_;
    if (!transfer.isIncremental) {
        transfer.isComplete = true;
        write(key, transfer, 0, size);
        const auto presume = [this, key] { presumeTaken(key); };
        if (transfer.taken) transfer.presumedTaken = session_.runLoop().performAfterDelay(PresumedTaking, presume);
        return;
    }
    const auto atLeast = static_cast<std::uint32_t>(std::min<std::size_t>(size, 0x7FFFFFFF));
    const auto cookie = xcb_change_property(session_.get(), XCB_PROP_MODE_REPLACE, key.first, key.second,
                                            session_.connection().atom("INCR"), 32, 1, &atLeast);
    transfer.written = cookie.sequence;
}

void X11SelectionTransfers::write(const Key& key, Transfer& transfer, std::size_t from, std::size_t count) const {
    const X11SelectionValue& value = transfer.value;
    const std::size_t unit = value.format / 8;
    const auto cookie =
        xcb_change_property(session_.get(), XCB_PROP_MODE_REPLACE, key.first, key.second, value.type, value.format,
                            static_cast<std::uint32_t>(count / unit), value.bytes->data() + from);
    transfer.written = cookie.sequence;
}

void X11SelectionTransfers::sendPiece(const Key& key, Transfer& transfer) {
    const std::size_t count = std::min(longestPiece_, transfer.value.bytes->size() - transfer.sent);
    write(key, transfer, transfer.sent, count);
    transfer.sent += count;
    transfer.isComplete = count == 0;  // an empty piece is the last
    transfer.lastMoved = session_.runLoop().now();
}

void X11SelectionTransfers::propertyWasRemoved(const Key& key, std::uint32_t sequence) {
    const auto found = transfers_.find(key);
    if (found == transfers_.end()) return;
    Transfer& transfer = found->second;
    // The server saw this removal before it saw what was written last: it was of what stood there before.
    if (static_cast<std::int32_t>(sequence - transfer.written) < 0) return;
    const bool hasLast = transfer.isIncremental && transfer.sent == transfer.value.bytes->size();
    const auto taken = transfer.isComplete || hasLast ? std::exchange(transfer.taken, nullptr) : nullptr;
    if (transfer.isComplete) {
        transfers_.erase(found);
    } else {
        sendPiece(key, transfer);
    }
    session_.flush();
    if (taken) taken();
}

void X11SelectionTransfers::presumeTaken(const Key& key) {
    const auto found = transfers_.find(key);
    if (found == transfers_.end()) return;
    if (const auto taken = std::exchange(found->second.taken, nullptr)) taken();
}

void X11SelectionTransfers::forgetWindow(xcb_window_t window) {
    std::erase_if(transfers_, [window](const auto& transfer) { return transfer.first.first == window; });
}

void X11SelectionTransfers::forgetIdle() {
    const double now = session_.runLoop().now();
    std::erase_if(transfers_, [now](const auto& transfer) { return now - transfer.second.lastMoved >= LongestIdle; });
    nextSweep_ = {};
    if (!transfers_.empty()) nextSweep_ = session_.runLoop().performAfterDelay(LongestIdle, [this] { forgetIdle(); });
}

}  // namespace plume
