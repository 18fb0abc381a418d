// Reading what another program offers in a selection.
//
// Belongs to the tap thread. Waits for the program in bounds: 0.3 s for its first answer to a question, one second in
// all for what is asked together. A program that has not answered, or has stopped in the middle, is left alone until
// the selection has another owner.
#pragma once

#include <xcb/xcb.h>

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "ports/x11/X11Session.h"
#include "ports/x11/clipboard/X11SelectionTransfers.h"

namespace plume {

class X11SelectionReader {
  public:
    // The session outlives the reader.
    X11SelectionReader(X11Session& session, std::string_view selection);
    X11SelectionReader(const X11SelectionReader&) = delete;
    X11SelectionReader& operator=(const X11SelectionReader&) = delete;

    // The names of what is on offer; asked once per owner.
    const std::vector<std::string>& targets();
    // Nothing when the program does not give it in time, or gives more than 64 MB.
    std::optional<X11SelectionValue> read(std::string_view target);
    // To be told, as soon as it is known, so that nothing waits for an owner that has gone.
    void ownerChanged();

  private:
    struct Question {
        xcb_atom_t target = XCB_ATOM_NONE;
        xcb_atom_t property = XCB_ATOM_NONE;
        xcb_timestamp_t time = 0;
        bool isAnswered = false;
        bool isRefused = false;
        bool hasNewPiece = false;
    };

    void noteAnswer(const xcb_generic_event_t& event);
    void notePiece(const xcb_generic_event_t& event);
    std::optional<X11SelectionValue> ask(xcb_atom_t target);
    std::optional<X11SelectionValue> takeAnswer();
    std::optional<X11SelectionValue> takePieces();
    std::optional<X11SelectionValue> takeProperty(std::size_t atMost);
    double secondsLeft();

    X11Session& session_;
    const xcb_atom_t selection_;
    Question question_;
    std::uint64_t owners_ = 0;  // how many there were
    bool isSilent_ = false;     // the present owner does not answer
    double spent_ = 0;          // seconds of waiting for the present owner
    double lastAsked_ = 0;
    std::uint32_t lastProperty_ = 0;
    std::optional<std::vector<std::string>> targets_;
    // What was read last, unless it is large: one text is asked for under several names.
    std::optional<std::pair<std::string, X11SelectionValue>> last_;
    Subscription answerObserver_;
    Subscription pieceObserver_;
};

}  // namespace plume
