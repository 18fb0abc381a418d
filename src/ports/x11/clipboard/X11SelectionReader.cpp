#include "ports/x11/clipboard/X11SelectionReader.h"

#include <algorithm>
#include <cstring>
#include <memory>

namespace plume {

namespace {

constexpr double LongestForFirstAnswer = 0.3;  // seconds
constexpr double LongestInAll = 1;
constexpr double ApartFromEarlierQuestions = 2;
constexpr std::size_t LargestValue = std::size_t{64} << 20;  // bytes
constexpr std::size_t LargestKept = std::size_t{1} << 20;
// An answer that comes too late must not be taken for the answer to a later question.
constexpr std::uint32_t Properties = 8;

}  // namespace

X11SelectionReader::X11SelectionReader(X11Session& session, std::string_view selection)
    : session_(session), selection_(session.connection().atom(selection)) {
    answerObserver_ =
        session_.addObserver(XCB_SELECTION_NOTIFY, [this](const xcb_generic_event_t& event) { noteAnswer(event); });
    pieceObserver_ =
        session_.addObserver(XCB_PROPERTY_NOTIFY, [this](const xcb_generic_event_t& event) { notePiece(event); });
}

void X11SelectionReader::ownerChanged() {
    ++owners_;
    isSilent_ = false;
    spent_ = 0;
    targets_.reset();
    last_.reset();
}

void X11SelectionReader::noteAnswer(const xcb_generic_event_t& event) {
    const auto& notify = reinterpret_cast<const xcb_selection_notify_event_t&>(event);
    if (notify.requestor != session_.window() || notify.selection != selection_) return;
    if (notify.target != question_.target) return;
    const bool refuses = notify.property == XCB_ATOM_NONE && notify.time == question_.time;
    if (!refuses && notify.property != question_.property) return;
    question_.isAnswered = true;
    question_.isRefused = refuses;
}

void X11SelectionReader::notePiece(const xcb_generic_event_t& event) {
    const auto& change = reinterpret_cast<const xcb_property_notify_event_t&>(event);
    const bool isNew = change.window == session_.window() && change.state == XCB_PROPERTY_NEW_VALUE;
    if (isNew && change.atom == question_.property) question_.hasNewPiece = true;
}

const std::vector<std::string>& X11SelectionReader::targets() {
    static const std::vector<std::string> none;
    if (targets_) return *targets_;
    const auto value = ask(session_.connection().atom("TARGETS"));
    if (!value || value->format != 32) return none;
    std::vector<xcb_atom_t> atoms(value->bytes->size() / 4);
    if (!atoms.empty()) std::memcpy(atoms.data(), value->bytes->data(), atoms.size() * 4);
    std::vector<std::string> names;
    for (const xcb_atom_t atom : atoms) {
        auto name = session_.connection().atomName(atom);
        if (!name.empty()) names.push_back(std::move(name));
    }
    return targets_.emplace(std::move(names));
}

std::optional<X11SelectionValue> X11SelectionReader::read(std::string_view target) {
    if (last_ && last_->first == target) return last_->second;
    auto value = ask(session_.connection().atom(target));
    last_.reset();
    if (value && value->bytes->size() <= LargestKept) last_.emplace(target, *value);
    return value;
}

double X11SelectionReader::secondsLeft() {
    if (session_.runLoop().now() - lastAsked_ > ApartFromEarlierQuestions) spent_ = 0;
    return LongestInAll - spent_;
}

std::optional<X11SelectionValue> X11SelectionReader::ask(xcb_atom_t target) {
    if (isSilent_ || secondsLeft() <= 0) return std::nullopt;
    const double start = session_.runLoop().now();
    const auto name = "PLUME_SELECTION_" + std::to_string(lastProperty_++ % Properties);
    question_ = {target, session_.connection().atom(name), session_.serverTime()};
    xcb_delete_property(session_.get(), session_.window(), question_.property);
    xcb_convert_selection(session_.get(), session_.window(), selection_, target, question_.property, question_.time);
    auto value = takeAnswer();
    question_ = {};
    session_.collect();
    lastAsked_ = session_.runLoop().now();
    spent_ += lastAsked_ - start;
    return value;
}

std::optional<X11SelectionValue> X11SelectionReader::takeAnswer() {
    const auto owner = owners_;
    const double bound = std::min(LongestForFirstAnswer, secondsLeft());
    session_.waitUntil([&] { return question_.isAnswered || owners_ != owner; }, bound);
    if (!question_.isAnswered) {
        isSilent_ = owners_ == owner;
        return std::nullopt;
    }
    if (question_.isRefused) return std::nullopt;
    question_.hasNewPiece = false;  // the owner writes pieces once the announcement is removed
    auto value = takeProperty(LargestValue);
    if (value && value->type == session_.connection().atom("INCR")) return takePieces();
    return value;
}

std::optional<X11SelectionValue> X11SelectionReader::takePieces() {
    const auto owner = owners_;
    const double end = session_.runLoop().now() + secondsLeft();
    auto bytes = std::make_shared<std::string>();
    X11SelectionValue whole;
    while (true) {
        session_.waitUntil([&] { return question_.hasNewPiece || owners_ != owner; }, end - session_.runLoop().now());
        if (!question_.hasNewPiece) {
            isSilent_ = owners_ == owner;
            return std::nullopt;
        }
        question_.hasNewPiece = false;
        const auto piece = takeProperty(LargestValue - bytes->size());
        if (!piece) return std::nullopt;
        whole.type = piece->type;
        whole.format = piece->format;
        if (piece->bytes->empty()) break;
        bytes->append(*piece->bytes);
    }
    whole.bytes = std::move(bytes);
    return whole;
}

std::optional<X11SelectionValue> X11SelectionReader::takeProperty(std::size_t atMost) {
    const auto words = static_cast<std::uint32_t>(atMost / 4 + 1);
    const XcbOwned<xcb_get_property_reply_t> reply(xcb_get_property_reply(
        session_.get(),
        xcb_get_property(session_.get(), 1, session_.window(), question_.property, XCB_GET_PROPERTY_TYPE_ANY, 0, words),
        nullptr));
    if (!reply || reply->type == XCB_ATOM_NONE) return std::nullopt;
    if (reply->bytes_after > 0) {
        xcb_delete_property(session_.get(), session_.window(), question_.property);
        return std::nullopt;
    }
    const auto* const bytes = static_cast<const char*>(xcb_get_property_value(reply.get()));
    const auto size = static_cast<std::size_t>(xcb_get_property_value_length(reply.get()));
    return X11SelectionValue{reply->type, reply->format, std::make_shared<const std::string>(bytes, size)};
}

}  // namespace plume
