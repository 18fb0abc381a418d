#include "ports/x11/clipboard/X11SelectionOwner.h"

#include <xcb/xfixes.h>

#include <cstring>
#include <string>
#include <utility>

namespace plume {

namespace {

constexpr int Attempts = 2;                      // somebody may have been quicker with a later time
constexpr std::uint32_t LongestMultiple = 4096;  // words

X11SelectionValue words(xcb_atom_t type, const std::vector<std::uint32_t>& words) {
    auto bytes = std::make_shared<std::string>(words.size() * 4, '\0');
    std::memcpy(bytes->data(), words.data(), bytes->size());
    return {type, 32, std::move(bytes)};
}

}  // namespace

X11SelectionOwner::X11SelectionOwner(X11Session& session, X11SelectionTransfers& transfers, std::string_view selection,
                                     Changed changed)
    : session_(session),
      transfers_(transfers),
      selection_(session.connection().atom(selection)),
      changed_(std::move(changed)) {
    xcb_xfixes_select_selection_input(session_.get(), session_.window(), selection_,
                                      XCB_XFIXES_SELECTION_EVENT_MASK_SET_SELECTION_OWNER |
                                          XCB_XFIXES_SELECTION_EVENT_MASK_SELECTION_WINDOW_DESTROY |
                                          XCB_XFIXES_SELECTION_EVENT_MASK_SELECTION_CLIENT_CLOSE);
    owner_ = askOwner();
    const auto* const xfixes = session_.connection().extension(xcb_xfixes_id);
    const auto notify = static_cast<std::uint8_t>(xfixes->first_event + XCB_XFIXES_SELECTION_NOTIFY);
    ownerObserver_ = session_.addObserver(notify, [this](const xcb_generic_event_t& event) { noteOwner(event); });
    requestHandler_ = session_.addHandler(XCB_SELECTION_REQUEST, [this](const xcb_generic_event_t& event) {
        answer(reinterpret_cast<const xcb_selection_request_event_t&>(event));
    });
}

void X11SelectionOwner::noteOwner(const xcb_generic_event_t& event) {
    const auto& notify = reinterpret_cast<const xcb_xfixes_selection_notify_event_t&>(event);
    if (notify.selection != selection_) return;
    owner_ = notify.owner;
    changed_(isOwner() || (releases_ && !hasOwner()));
}

xcb_window_t X11SelectionOwner::askOwner() const {
    const XcbOwned<xcb_get_selection_owner_reply_t> reply(
        xcb_get_selection_owner_reply(session_.get(), xcb_get_selection_owner(session_.get(), selection_), nullptr));
    return reply ? reply->owner : xcb_window_t{XCB_WINDOW_NONE};
}

bool X11SelectionOwner::own(std::shared_ptr<X11SelectionContent> content, xcb_timestamp_t now) {
    content_ = std::move(content);
    for (int attempt = 0; attempt < Attempts; ++attempt) {
        ownedSince_ = now != 0 ? std::exchange(now, 0) : session_.serverTime();
        if (ownedSince_ == 0) return false;
        xcb_set_selection_owner(session_.get(), session_.window(), selection_, ownedSince_);
        const bool isOurs = askOwner() == session_.window();
        // By now the server's notification is here; what it notes may be that somebody has the selection already.
        session_.collect();
        if (isOurs) return isOwner();
    }
    return false;
}

void X11SelectionOwner::release() {
    content_.reset();
    releases_ = true;
    xcb_set_selection_owner(session_.get(), XCB_WINDOW_NONE, selection_, session_.serverTime());
    askOwner();
    session_.collect();
    releases_ = false;
}

void X11SelectionOwner::answer(const xcb_selection_request_event_t& request) {
    if (request.selection != selection_ || request.owner != session_.window()) return;
    // Old programs leave the choice of the property to the owner.
    const xcb_atom_t property = request.property != XCB_ATOM_NONE ? request.property : request.target;
    const bool isMultiple = request.target == session_.connection().atom("MULTIPLE");
    bool given = false;
    if (isOwner() && content_) {
        const Content instead =
            contentInstead ? contentInstead(request.requestor, request.target, request.time) : nullptr;
        const Content content = instead ? instead : content_;
        given = isMultiple ? giveMultiple(content, request.requestor, request.property)
                           : give(content, request.requestor, request.target, property);
    }
    sendNotify(request, given ? property : xcb_atom_t{XCB_ATOM_NONE});
    if (given && toldTargets && request.target == session_.connection().atom("TARGETS")) toldTargets(request.requestor);
}

void X11SelectionOwner::sendNotify(const xcb_selection_request_event_t& request, xcb_atom_t property) {
    // Events are always sent as 32 bytes.
    union {
        xcb_selection_notify_event_t notify;
        char bytes[32];
    } event{};
    event.notify.response_type = XCB_SELECTION_NOTIFY;
    event.notify.time = request.time;
    event.notify.requestor = request.requestor;
    event.notify.selection = request.selection;
    event.notify.target = request.target;
    event.notify.property = property;
    xcb_send_event(session_.get(), 0, request.requestor, XCB_EVENT_MASK_NO_EVENT, event.bytes);
    session_.flush();
}

bool X11SelectionOwner::give(const Content& content, xcb_window_t requestor, xcb_atom_t target, xcb_atom_t property) {
    XcbConnection& connection = session_.connection();
    if (target == connection.atom("TARGETS")) {
        transfers_.send(requestor, property, targetsOf(*content), nullptr);
        return true;
    }
    if (target == connection.atom("TIMESTAMP")) {
        transfers_.send(requestor, property, words(XCB_ATOM_INTEGER, {ownedSince_}), nullptr);
        return true;
    }
    auto value = content->value(target);
    if (!value) return false;
    std::function<void()> taken;
    if (readingCounts && readingCounts(requestor)) {
        if (isGiven) isGiven(requestor);
        taken = [this, content = std::weak_ptr(content), requestor, target] { noteRead(content, requestor, target); };
    }
    transfers_.send(requestor, property, std::move(*value), std::move(taken));
    return true;
}

void X11SelectionOwner::noteRead(const std::weak_ptr<X11SelectionContent>& content, xcb_window_t requestor,
                                 xcb_atom_t target) const {
    // Content that has been replaced since was taken by somebody, but it is no longer what its owner offers.
    const auto tell = [content, target] {
        if (const auto still = content.lock()) still->wasTaken(target);
    };
    if (wasRead) return wasRead(requestor, tell);
    tell();
}

// The property holds pairs of target and property; where a target cannot be had its property becomes none.
bool X11SelectionOwner::giveMultiple(const Content& content, xcb_window_t requestor, xcb_atom_t property) {
    if (property == XCB_ATOM_NONE) return false;
    const XcbOwned<xcb_get_property_reply_t> reply(xcb_get_property_reply(
        session_.get(),
        xcb_get_property(session_.get(), 0, requestor, property, XCB_GET_PROPERTY_TYPE_ANY, 0, LongestMultiple),
        nullptr));
    if (!reply || reply->format != 32) return false;
    std::vector<std::uint32_t> pairs(static_cast<std::size_t>(xcb_get_property_value_length(reply.get())) / 4);
    if (pairs.empty()) return false;
    std::memcpy(pairs.data(), xcb_get_property_value(reply.get()), pairs.size() * 4);
    const xcb_atom_t multiple = session_.connection().atom("MULTIPLE");
    for (std::size_t i = 0; i + 1 < pairs.size(); i += 2) {
        const bool isPlain = pairs[i] != multiple && pairs[i + 1] != XCB_ATOM_NONE;
        if (!isPlain || !give(content, requestor, pairs[i], pairs[i + 1])) pairs[i + 1] = XCB_ATOM_NONE;
    }
    xcb_change_property(session_.get(), XCB_PROP_MODE_REPLACE, requestor, property, reply->type, 32,
                        static_cast<std::uint32_t>(pairs.size()), pairs.data());
    return true;
}

X11SelectionValue X11SelectionOwner::targetsOf(X11SelectionContent& content) const {
    XcbConnection& connection = session_.connection();
    std::vector<std::uint32_t> targets = {connection.atom("TARGETS"), connection.atom("TIMESTAMP"),
                                          connection.atom("MULTIPLE")};
    const auto offered = content.targets();
    targets.insert(targets.end(), offered.begin(), offered.end());
    return words(XCB_ATOM_ATOM, targets);
}

}  // namespace plume
