#include "testing/rig/XClient.h"

#include <cstring>

#include "testing/rig/Deadline.h"
#include "testing/rig/XcbReply.h"

namespace plume::rig {

namespace {

constexpr xcb_window_t NoWindow = XCB_WINDOW_NONE;
constexpr Milliseconds ActivationBound{5'000};
constexpr Milliseconds AskAgain{4};  // for what the server does not announce, such as the input focus

}  // namespace

XClient::XClient(const std::string& display) : connection_(xcb_connect(display.c_str(), nullptr)) {
    if (xcb_connection_has_error(connection_) != 0) {
        xcb_disconnect(connection_);
        throw RigError("cannot connect to the X server " + display);
    }
    screen_ = xcb_setup_roots_iterator(xcb_get_setup(connection_)).data;
    const std::uint32_t events = XCB_EVENT_MASK_PROPERTY_CHANGE;
    xcb_change_window_attributes(connection_, root(), XCB_CW_EVENT_MASK, &events);
}

XClient::~XClient() {
    xcb_disconnect(connection_);
}

xcb_atom_t XClient::atom(const std::string& name) {
    const auto cookie = xcb_intern_atom(connection_, 0, static_cast<std::uint16_t>(name.size()), name.c_str());
    const auto reply = own(xcb_intern_atom_reply(connection_, cookie, nullptr));
    return reply ? reply->atom : xcb_atom_t{XCB_ATOM_NONE};
}

std::string XClient::property(xcb_window_t window, const std::string& name) {
    constexpr std::uint32_t LongestInWords = 1 << 20;
    const auto cookie = xcb_get_property(connection_, 0, window, atom(name), XCB_ATOM_ANY, 0, LongestInWords);
    const auto reply = own(xcb_get_property_reply(connection_, cookie, nullptr));
    if (!reply) return {};
    return {static_cast<const char*>(xcb_get_property_value(reply.get())),
            static_cast<std::size_t>(xcb_get_property_value_length(reply.get()))};
}

xcb_window_t XClient::windowProperty(xcb_window_t window, const std::string& name) {
    const std::string bytes = property(window, name);
    xcb_window_t value = XCB_WINDOW_NONE;
    if (bytes.size() >= sizeof value) std::memcpy(&value, bytes.data(), sizeof value);
    return value;
}

xcb_window_t XClient::activeWindow() {
    return windowProperty(root(), "_NET_ACTIVE_WINDOW");
}

xcb_window_t XClient::focusedWindow() {
    const auto reply = own(xcb_get_input_focus_reply(connection_, xcb_get_input_focus(connection_), nullptr));
    return reply ? reply->focus : NoWindow;
}

bool XClient::isButtonDown() {
    const auto reply = own(xcb_query_pointer_reply(connection_, xcb_query_pointer(connection_, root()), nullptr));
    constexpr std::uint16_t AnyButton = XCB_BUTTON_MASK_1 | XCB_BUTTON_MASK_2 | XCB_BUTTON_MASK_3;
    return reply && (reply->mask & AnyButton) != 0;
}

xcb_window_t XClient::selectionOwner(const std::string& selection) {
    const auto cookie = xcb_get_selection_owner(connection_, atom(selection));
    const auto reply = own(xcb_get_selection_owner_reply(connection_, cookie, nullptr));
    return reply ? reply->owner : NoWindow;
}

void XClient::emptySelection(const std::string& selection) {
    xcb_set_selection_owner(connection_, NoWindow, atom(selection), XCB_CURRENT_TIME);
    selectionOwner(selection);  // a round trip
}

bool XClient::exists(xcb_window_t window) {
    return own(xcb_get_geometry_reply(connection_, xcb_get_geometry(connection_, window), nullptr)) != nullptr;
}

bool XClient::areOfSameClient(xcb_window_t one, xcb_window_t other) const {
    return ((one ^ other) & ~xcb_get_setup(connection_)->resource_id_mask) == 0;
}

std::vector<xcb_window_t> XClient::managedWindows() {
    const std::string bytes = property(root(), "_NET_CLIENT_LIST");
    std::vector<xcb_window_t> windows(bytes.size() / sizeof(xcb_window_t));
    if (!windows.empty()) std::memcpy(windows.data(), bytes.data(), windows.size() * sizeof(xcb_window_t));
    return windows;
}

std::vector<int> XClient::keysDown() {
    const auto reply = own(xcb_query_keymap_reply(connection_, xcb_query_keymap(connection_), nullptr));
    if (!reply) throw RigError("the X server does not tell which keys are down");
    std::vector<int> down;
    for (int key = 0; key < 256; ++key) {
        if ((reply->keys[key / 8] >> (key % 8) & 1) != 0) down.push_back(key);
    }
    return down;
}

std::uint16_t XClient::modifiers() {
    const auto reply = own(xcb_query_pointer_reply(connection_, xcb_query_pointer(connection_, root()), nullptr));
    if (!reply) throw RigError("the X server does not tell which modifiers are down");
    return reply->mask & 0xFF;
}

XClient::Place XClient::placeOf(xcb_window_t window) {
    const auto geometry = own(xcb_get_geometry_reply(connection_, xcb_get_geometry(connection_, window), nullptr));
    const auto cookie = xcb_translate_coordinates(connection_, window, root(), 0, 0);
    const auto origin = own(xcb_translate_coordinates_reply(connection_, cookie, nullptr));
    if (!geometry || !origin) return {};
    return {origin->dst_x, origin->dst_y, geometry->width, geometry->height};
}

std::vector<xcb_window_t> XClient::treeOf(xcb_window_t window) {
    std::vector<xcb_window_t> windows{window};
    for (std::size_t i = 0; i < windows.size(); ++i) {
        const auto tree = own(xcb_query_tree_reply(connection_, xcb_query_tree(connection_, windows[i]), nullptr));
        if (!tree) continue;
        const auto* children = xcb_query_tree_children(tree.get());
        windows.insert(windows.end(), children, children + xcb_query_tree_children_length(tree.get()));
    }
    return windows;
}

bool XClient::isInside(xcb_window_t window, xcb_window_t ancestor) {
    while (window > XCB_INPUT_FOCUS_POINTER_ROOT && window != root()) {
        if (window == ancestor) return true;
        const auto tree = own(xcb_query_tree_reply(connection_, xcb_query_tree(connection_, window), nullptr));
        if (!tree) return false;
        window = tree->parent;
    }
    return false;
}

void XClient::activate(xcb_window_t window) {
    constexpr std::uint32_t AskedByPager = 2;
    xcb_client_message_event_t message{};
    message.response_type = XCB_CLIENT_MESSAGE;
    message.format = 32;
    message.window = window;
    message.type = atom("_NET_ACTIVE_WINDOW");
    message.data.data32[0] = AskedByPager;
    xcb_send_event(connection_, 0, root(), XCB_EVENT_MASK_SUBSTRUCTURE_NOTIFY | XCB_EVENT_MASK_SUBSTRUCTURE_REDIRECT,
                   reinterpret_cast<const char*>(&message));
    xcb_flush(connection_);
    await("activating window " + std::to_string(window), ActivationBound,
          [&] { return activeWindow() == window && isInside(focusedWindow(), window); });
}

void XClient::await(const std::string& what, Milliseconds bound, const std::function<bool()>& condition) {
    const Deadline deadline(bound);
    while (!condition()) {
        if (deadline.passed()) throw RigError(what + " did not happen in time");
        if (xcb_connection_has_error(connection_) != 0) throw RigError(what + ": the X server has gone");
        deadline.waitReadable(xcb_get_file_descriptor(connection_), AskAgain);
        while (own(xcb_poll_for_event(connection_))) {
        }
    }
}

}  // namespace plume::rig
