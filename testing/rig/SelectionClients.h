// Other programs on the clipboard, each with a connection of its own.
#pragma once

#include <xcb/xcb.h>

#include <atomic>
#include <cstdint>
#include <functional>
#include <map>
#include <memory>
#include <optional>
#include <string>
#include <thread>
#include <utility>
#include <vector>

#include "ports/x11/XcbConnection.h"
#include "testing/rig/XClient.h"

namespace plume::rig {

// A property's content, its type by name.
struct SelectionData {
    std::string type;
    int format = 8;
    std::string bytes;

    bool operator==(const SelectionData&) const = default;
};

using SelectionOffer = std::vector<std::pair<std::string, SelectionData>>;

// A program that owns a selection from its construction on and serves it from a thread of its own.
class ForeignOwner {
  public:
    enum class Behaviour { Answers, NeverAnswers, DiesInTheMiddle };
    struct Options {
        std::string selection = "CLIPBOARD";
        Behaviour behaviour = Behaviour::Answers;
        std::size_t longestPiece = std::size_t{256} * 1024;         // longer values go in pieces
        std::function<void(const std::string&)> beforeAnswer = {};  // gets the target; on the owner's thread
    };

    ForeignOwner(const std::string& display, SelectionOffer offer, Options options);  // throws RigError
    ForeignOwner(const std::string& display, SelectionOffer offer)
        : ForeignOwner(display, std::move(offer), Options{}) {}
    ~ForeignOwner();
    ForeignOwner(const ForeignOwner&) = delete;
    ForeignOwner& operator=(const ForeignOwner&) = delete;

    xcb_window_t window() const { return window_; }
    // How many requests have come.
    int requests() const { return requests_; }

  private:
    struct Transfer {
        const SelectionData* data = nullptr;
        std::size_t sent = 0;
    };

    void serve();
    bool handle(const xcb_generic_event_t& event);
    void answer(const xcb_selection_request_event_t& request);
    bool write(const xcb_selection_request_event_t& request, xcb_atom_t property);
    void writePiece(xcb_window_t requestor, xcb_atom_t property);
    void writeTargets(xcb_window_t requestor, xcb_atom_t property);

    const SelectionOffer offer_;
    const Options options_;
    std::unique_ptr<XcbConnection> connection_;
    xcb_window_t window_ = XCB_WINDOW_NONE;
    std::map<std::pair<xcb_window_t, xcb_atom_t>, Transfer> transfers_;
    std::atomic<int> requests_ = 0;
    std::atomic<bool> stops_ = false;
    std::thread thread_;
};

// A program that reads selections. One thread at a time.
class SelectionRequestor {
  public:
    explicit SelectionRequestor(const std::string& display);  // throws RigError
    ~SelectionRequestor();
    SelectionRequestor(const SelectionRequestor&) = delete;
    SelectionRequestor& operator=(const SelectionRequestor&) = delete;

    // Shows its window and gives it the keyboard focus.
    void comeToFront(XClient& client);

    // Takes a selection, gives nothing to those who ask for it, and says that it answers pings.
    void own(const std::string& selection);
    // Waits for a ping, and answers it. Throws RigError when none comes.
    void answerPing();

    // What the owner gives; nothing when it refuses. Throws RigError when it does not answer.
    std::optional<SelectionData> request(const std::string& selection, const std::string& target);
    // The same, but what was given stays in its place, as some programs leave it.
    std::optional<SelectionData> requestAndLeave(const std::string& selection, const std::string& target);
    // Several targets by one MULTIPLE request; refused ones are missing.
    std::map<std::string, SelectionData> requestMultiple(const std::string& selection,
                                                         const std::vector<std::string>& targets);
    std::vector<std::string> targets(const std::string& selection);
    // Everything that is on offer, as a clipboard manager reads it.
    std::map<std::string, SelectionData> readAll(const std::string& selection);
    // Asks, waits for the answer and leaves it lying, or takes the announcement of pieces and no piece.
    void requestAndStop(const std::string& selection, const std::string& target);

    // The moment that requests are for from now on; none in particular at first.
    void setRequestTime(xcb_timestamp_t time) { requestTime_ = time; }

    // How many pieces the last value came in; 0 for one that came whole.
    int pieces() const { return pieces_; }

  private:
    void next(const std::string& what);
    void convert(const std::string& selection, const std::string& target, xcb_atom_t property);
    bool awaitAnswer();
    std::optional<SelectionData> take(xcb_atom_t property, bool removes = true);
    SelectionData takeWhole(xcb_atom_t property);

    std::unique_ptr<XcbConnection> connection_;
    xcb_window_t window_ = XCB_WINDOW_NONE;
    std::map<xcb_atom_t, int> newValues_;
    std::optional<xcb_atom_t> answer_;
    std::optional<xcb_client_message_event_t> ping_;
    int pieces_ = 0;
    xcb_timestamp_t requestTime_ = XCB_CURRENT_TIME;
};

std::vector<std::uint32_t> wordsOf(const std::string& bytes);

}  // namespace plume::rig
