#include "testing/rig/SelectionClients.h"

#include <poll.h>

#include <algorithm>
#include <cstring>

#include "testing/rig/Deadline.h"

namespace plume::rig {

namespace {

constexpr Milliseconds AnswerBound{10'000};
constexpr Milliseconds StopBound{20};

std::unique_ptr<XcbConnection> connect(const std::string& display) {
    auto connection = XcbConnection::open(display);
    if (!connection) throw RigError(connection.error().message);
    return std::move(connection).value();
}

xcb_window_t makeWindow(XcbConnection& connection) {
    const xcb_window_t window = xcb_generate_id(connection.get());
    const std::uint32_t events = XCB_EVENT_MASK_PROPERTY_CHANGE;
    xcb_create_window(connection.get(), XCB_COPY_FROM_PARENT, window, connection.root(), 0, 0, 50, 50, 0,
                      XCB_WINDOW_CLASS_INPUT_OUTPUT, XCB_COPY_FROM_PARENT, XCB_CW_EVENT_MASK, &events);
    return window;
}

void setProperty(XcbConnection& connection, xcb_window_t window, xcb_atom_t property, const SelectionData& data,
                 std::size_t from, std::size_t count) {
    const auto units = static_cast<std::uint32_t>(count / static_cast<std::size_t>(data.format / 8));
    xcb_change_property(connection.get(), XCB_PROP_MODE_REPLACE, window, property, connection.atom(data.type),
                        static_cast<std::uint8_t>(data.format), units, data.bytes.data() + from);
}

}  // namespace

std::vector<std::uint32_t> wordsOf(const std::string& bytes) {
    std::vector<std::uint32_t> words(bytes.size() / sizeof(std::uint32_t));
    if (!words.empty()) std::memcpy(words.data(), bytes.data(), words.size() * sizeof(std::uint32_t));
    return words;
}

ForeignOwner::ForeignOwner(const std::string& display, SelectionOffer offer, Options options)
    : offer_(std::move(offer)),
      options_(std::move(options)),
      connection_(connect(display)),
      window_(makeWindow(*connection_)) {
    const xcb_atom_t selection = connection_->atom(options_.selection);
    xcb_set_selection_owner(connection_->get(), window_, selection, XCB_CURRENT_TIME);
    connection_->sync();
    thread_ = std::thread([this] { serve(); });
}

ForeignOwner::~ForeignOwner() {
    stops_ = true;
    thread_.join();
}

void ForeignOwner::serve() {
    while (!stops_) {
        while (const auto event = connection_->pollEvent()) {
            if (!handle(*event)) {
                connection_.reset();
                return;
            }
        }
        connection_->flush();
        pollfd entry{connection_->descriptor(), POLLIN, 0};
        poll(&entry, 1, static_cast<int>(StopBound.count()));
    }
}

bool ForeignOwner::handle(const xcb_generic_event_t& event) {
    const int type = event.response_type & 0x7F;
    if (type == XCB_SELECTION_REQUEST) {
        ++requests_;
        if (options_.behaviour == Behaviour::NeverAnswers) return true;
        answer(reinterpret_cast<const xcb_selection_request_event_t&>(event));
    } else if (type == XCB_PROPERTY_NOTIFY) {
        const auto& change = reinterpret_cast<const xcb_property_notify_event_t&>(event);
        const bool moves = change.state == XCB_PROPERTY_DELETE && transfers_.contains({change.window, change.atom});
        if (moves && options_.behaviour == Behaviour::DiesInTheMiddle) return false;
        if (moves) writePiece(change.window, change.atom);
    }
    return true;
}

void ForeignOwner::answer(const xcb_selection_request_event_t& request) {
    if (options_.beforeAnswer) options_.beforeAnswer(connection_->atomName(request.target));
    union {
        xcb_selection_notify_event_t notify;
        char bytes[32];
    } event{};
    event.notify.response_type = XCB_SELECTION_NOTIFY;
    event.notify.time = request.time;
    event.notify.requestor = request.requestor;
    event.notify.selection = request.selection;
    event.notify.target = request.target;
    event.notify.property = write(request, request.property) ? request.property : xcb_atom_t{XCB_ATOM_NONE};
    xcb_send_event(connection_->get(), 0, request.requestor, 0, event.bytes);
}

bool ForeignOwner::write(const xcb_selection_request_event_t& request, xcb_atom_t property) {
    const std::string target = connection_->atomName(request.target);
    if (target == "TARGETS") {
        writeTargets(request.requestor, property);
        return true;
    }
    const auto found = std::find_if(offer_.begin(), offer_.end(), [&](const auto& one) { return one.first == target; });
    if (found == offer_.end()) return false;
    const SelectionData& data = found->second;
    if (data.bytes.size() <= options_.longestPiece) {
        setProperty(*connection_, request.requestor, property, data, 0, data.bytes.size());
        return true;
    }
    const std::uint32_t events = XCB_EVENT_MASK_PROPERTY_CHANGE;
    xcb_change_window_attributes(connection_->get(), request.requestor, XCB_CW_EVENT_MASK, &events);
    transfers_[{request.requestor, property}] = Transfer{&data, 0};
    const auto size = static_cast<std::uint32_t>(data.bytes.size());
    xcb_change_property(connection_->get(), XCB_PROP_MODE_REPLACE, request.requestor, property,
                        connection_->atom("INCR"), 32, 1, &size);
    return true;
}

void ForeignOwner::writePiece(xcb_window_t requestor, xcb_atom_t property) {
    const auto found = transfers_.find({requestor, property});
    Transfer& transfer = found->second;
    const std::size_t count = std::min(options_.longestPiece, transfer.data->bytes.size() - transfer.sent);
    setProperty(*connection_, requestor, property, *transfer.data, transfer.sent, count);
    transfer.sent += count;
    if (count == 0) transfers_.erase(found);
}

void ForeignOwner::writeTargets(xcb_window_t requestor, xcb_atom_t property) {
    std::vector<xcb_atom_t> atoms = {connection_->atom("TARGETS"), connection_->atom("MULTIPLE"),
                                     connection_->atom("SAVE_TARGETS"), connection_->atom("TIMESTAMP")};
    for (const auto& one : offer_) atoms.push_back(connection_->atom(one.first));
    xcb_change_property(connection_->get(), XCB_PROP_MODE_REPLACE, requestor, property, XCB_ATOM_ATOM, 32,
                        static_cast<std::uint32_t>(atoms.size()), atoms.data());
}

SelectionRequestor::SelectionRequestor(const std::string& display)
    : connection_(connect(display)), window_(makeWindow(*connection_)) {
    connection_->sync();
}

SelectionRequestor::~SelectionRequestor() = default;

void SelectionRequestor::comeToFront(XClient& client) {
    xcb_map_window(connection_->get(), window_);
    connection_->sync();
    client.await("the requestor's window", AnswerBound, [&] {
        const auto managed = client.managedWindows();
        return std::find(managed.begin(), managed.end(), window_) != managed.end();
    });
    client.activate(window_);
}

void SelectionRequestor::own(const std::string& selection) {
    const xcb_atom_t ping = connection_->atom("_NET_WM_PING");
    xcb_change_property(connection_->get(), XCB_PROP_MODE_REPLACE, window_, connection_->atom("WM_PROTOCOLS"),
                        XCB_ATOM_ATOM, 32, 1, &ping);
    xcb_set_selection_owner(connection_->get(), window_, connection_->atom(selection), XCB_CURRENT_TIME);
    connection_->sync();
}

void SelectionRequestor::answerPing() {
    while (!ping_) next("a ping");
    ping_->window = connection_->root();
    xcb_send_event(connection_->get(), 0, ping_->window,
                   XCB_EVENT_MASK_SUBSTRUCTURE_NOTIFY | XCB_EVENT_MASK_SUBSTRUCTURE_REDIRECT,
                   reinterpret_cast<const char*>(&*ping_));
    ping_.reset();
    connection_->sync();
}

void SelectionRequestor::next(const std::string& what) {
    const Deadline deadline(AnswerBound);
    while (true) {
        connection_->flush();  // first: while it sends, the library may read
        const auto event = connection_->pollEvent();
        if (!event) {
            if (deadline.passed() || connection_->isBroken()) throw RigError(what + " did not come");
            deadline.waitReadable(connection_->descriptor());
            continue;
        }
        const int type = event->response_type & 0x7F;
        if (type == XCB_SELECTION_NOTIFY) {
            answer_ = reinterpret_cast<const xcb_selection_notify_event_t&>(*event).property;
            return;
        }
        if (type == XCB_CLIENT_MESSAGE) {
            ping_ = reinterpret_cast<const xcb_client_message_event_t&>(*event);
            return;
        }
        if (type != XCB_PROPERTY_NOTIFY) continue;
        const auto& change = reinterpret_cast<const xcb_property_notify_event_t&>(*event);
        if (change.state == XCB_PROPERTY_NEW_VALUE) ++newValues_[change.atom];
        return;
    }
}

void SelectionRequestor::convert(const std::string& selection, const std::string& target, xcb_atom_t property) {
    answer_.reset();
    pieces_ = 0;
    xcb_convert_selection(connection_->get(), window_, connection_->atom(selection), connection_->atom(target),
                          property, requestTime_);
}

bool SelectionRequestor::awaitAnswer() {
    while (!answer_) next("the owner's answer");
    newValues_.clear();
    return *answer_ != XCB_ATOM_NONE;
}

std::optional<SelectionData> SelectionRequestor::take(xcb_atom_t property, bool removes) {
    constexpr std::uint32_t All = 0x1FFFFFFF;
    const XcbOwned<xcb_get_property_reply_t> reply(xcb_get_property_reply(
        connection_->get(),
        xcb_get_property(connection_->get(), removes ? 1 : 0, window_, property, XCB_GET_PROPERTY_TYPE_ANY, 0, All),
        nullptr));
    if (!reply || reply->type == XCB_ATOM_NONE) return std::nullopt;
    return SelectionData{connection_->atomName(reply->type), reply->format,
                         std::string(static_cast<const char*>(xcb_get_property_value(reply.get())),
                                     static_cast<std::size_t>(xcb_get_property_value_length(reply.get())))};
}

SelectionData SelectionRequestor::takeWhole(xcb_atom_t property) {
    auto whole = take(property);
    if (!whole) throw RigError("the owner's answer holds nothing");
    if (whole->type != "INCR") return *whole;
    whole->bytes.clear();
    while (true) {
        while (newValues_[property] == 0) next("the next piece");
        --newValues_[property];
        const auto piece = take(property);
        if (!piece) throw RigError("a piece holds nothing");
        whole->type = piece->type;
        whole->format = piece->format;
        if (piece->bytes.empty()) return *whole;
        ++pieces_;
        whole->bytes += piece->bytes;
    }
}

std::optional<SelectionData> SelectionRequestor::request(const std::string& selection, const std::string& target) {
    const xcb_atom_t property = connection_->atom("RIG_SELECTION");
    convert(selection, target, property);
    if (!awaitAnswer()) return std::nullopt;
    return takeWhole(property);
}

std::optional<SelectionData> SelectionRequestor::requestAndLeave(const std::string& selection,
                                                                 const std::string& target) {
    const xcb_atom_t property = connection_->atom("RIG_SELECTION");
    convert(selection, target, property);
    return awaitAnswer() ? take(property, false) : std::nullopt;
}

std::map<std::string, SelectionData> SelectionRequestor::requestMultiple(const std::string& selection,
                                                                         const std::vector<std::string>& targets) {
    const xcb_atom_t property = connection_->atom("RIG_MULTIPLE");
    std::vector<xcb_atom_t> pairs;
    for (std::size_t i = 0; i < targets.size(); ++i) {
        pairs.push_back(connection_->atom(targets[i]));
        pairs.push_back(connection_->atom("RIG_PART_" + std::to_string(i)));
    }
    xcb_change_property(connection_->get(), XCB_PROP_MODE_REPLACE, window_, property, connection_->atom("ATOM_PAIR"),
                        32, static_cast<std::uint32_t>(pairs.size()), pairs.data());
    convert(selection, "MULTIPLE", property);
    if (!awaitAnswer()) return {};
    const auto answered = wordsOf(take(property).value_or(SelectionData{}).bytes);
    std::map<std::string, SelectionData> values;
    for (std::size_t i = 0; i + 1 < answered.size(); i += 2) {
        if (answered[i + 1] != XCB_ATOM_NONE) values[targets[i / 2]] = takeWhole(answered[i + 1]);
    }
    return values;
}

std::vector<std::string> SelectionRequestor::targets(const std::string& selection) {
    const auto answered = request(selection, "TARGETS");
    std::vector<std::string> names;
    if (!answered) return names;
    for (const auto atom : wordsOf(answered->bytes)) names.push_back(connection_->atomName(atom));
    return names;
}

std::map<std::string, SelectionData> SelectionRequestor::readAll(const std::string& selection) {
    std::map<std::string, SelectionData> values;
    for (const std::string& target : targets(selection)) {
        const bool isMeta = target == "TARGETS" || target == "MULTIPLE" || target == "SAVE_TARGETS";
        const auto value = isMeta ? std::nullopt : request(selection, target);
        if (value) values[target] = *value;
    }
    values.erase("TIMESTAMP");
    return values;
}

void SelectionRequestor::requestAndStop(const std::string& selection, const std::string& target) {
    const xcb_atom_t property = connection_->atom("RIG_SELECTION");
    convert(selection, target, property);
    if (!awaitAnswer()) throw RigError("the owner refuses " + target);
    if (take(property)->type != "INCR") throw RigError(target + " came whole");
    connection_->sync();
}

}  // namespace plume::rig
