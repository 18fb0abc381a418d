// Owning a selection and answering those who want its content.
//
// Belongs to the tap thread.
#pragma once

#include <xcb/xcb.h>

#include <functional>
#include <memory>
#include <optional>
#include <string_view>
#include <vector>

#include "ports/x11/X11Session.h"
#include "ports/x11/clipboard/X11SelectionTransfers.h"

namespace plume {

// What a selection offers.
class X11SelectionContent {
  public:
    virtual ~X11SelectionContent() = default;
    virtual std::vector<xcb_atom_t> targets() = 0;
    // Nothing when the target cannot be had.
    virtual std::optional<X11SelectionValue> value(xcb_atom_t target) = 0;
    // Somebody whose reading counts has read the target's value to its end.
    virtual void wasTaken(xcb_atom_t target) = 0;
};

class X11SelectionOwner {
  public:
    // Called for every change of the owner, as soon as it is known; `ours` says that we made it.
    using Changed = std::function<void(bool ours)>;

    // Needs XFixes. The session and the transfers outlive the owner.
    X11SelectionOwner(X11Session& session, X11SelectionTransfers& transfers, std::string_view selection,
                      Changed changed);
    X11SelectionOwner(const X11SelectionOwner&) = delete;
    X11SelectionOwner& operator=(const X11SelectionOwner&) = delete;

    // Whether reading by this window counts; asked when its request comes.
    std::function<bool(xcb_window_t)> readingCounts;
    // This window is given something, or has read it to its end, and that counts. Whoever hears of the end calls
    // `tell`, which tells the content, at once or later. Either may be empty.
    std::function<void(xcb_window_t)> isGiven;
    std::function<void(xcb_window_t, std::function<void()> tell)> wasRead;
    // Other content than what is offered, for those who still are to have it; null for all others. May be empty.
    std::function<std::shared_ptr<X11SelectionContent>(xcb_window_t requestor, xcb_atom_t target, xcb_timestamp_t time)>
        contentInstead;
    // This window has asked what is on offer, and the answer was sent. May be empty.
    std::function<void(xcb_window_t)> toldTargets;

    // Takes the selection and offers this content; false when the server did not give it to us. `now` is the server's
    // time, for those who have asked for it.
    bool own(std::shared_ptr<X11SelectionContent> content, xcb_timestamp_t now = 0);
    // Leaves the selection without an owner.
    void release();
    // As far as it is known: collect() first.
    bool isOwner() const { return owner_ == session_.window(); }
    // Since when, in the server's time, if it is ours.
    xcb_timestamp_t ownedSince() const { return ownedSince_; }
    // Any owner at all.
    bool hasOwner() const { return owner_ != XCB_WINDOW_NONE; }
    // None without one.
    xcb_window_t owner() const { return owner_; }
    // What is or was offered last.
    const std::shared_ptr<X11SelectionContent>& content() const { return content_; }

  private:
    void noteOwner(const xcb_generic_event_t& event);
    xcb_window_t askOwner() const;
    using Content = std::shared_ptr<X11SelectionContent>;

    void answer(const xcb_selection_request_event_t& request);
    void sendNotify(const xcb_selection_request_event_t& request, xcb_atom_t property);
    bool give(const Content& content, xcb_window_t requestor, xcb_atom_t target, xcb_atom_t property);
    void noteRead(const std::weak_ptr<X11SelectionContent>& content, xcb_window_t requestor, xcb_atom_t target) const;
    bool giveMultiple(const Content& content, xcb_window_t requestor, xcb_atom_t property);
    X11SelectionValue targetsOf(X11SelectionContent& content) const;

    X11Session& session_;
    X11SelectionTransfers& transfers_;
    const xcb_atom_t selection_;
    const Changed changed_;
    std::shared_ptr<X11SelectionContent> content_;
    xcb_window_t owner_ = XCB_WINDOW_NONE;
    xcb_timestamp_t ownedSince_ = 0;
    bool releases_ = false;
    Subscription requestHandler_;
    Subscription ownerObserver_;
};

}  // namespace plume
