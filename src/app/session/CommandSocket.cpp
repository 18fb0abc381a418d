#include "app/session/CommandSocket.h"

#include <fcntl.h>
#include <sys/socket.h>
#include <sys/stat.h>
#include <sys/un.h>
#include <unistd.h>

#include <algorithm>
#include <array>
#include <cerrno>
#include <charconv>
#include <cstring>
#include <system_error>
#include <utility>

namespace plume {

namespace {

constexpr std::size_t LongestRequest = std::size_t{1} << 20;
constexpr std::size_t LongestReply = std::size_t{64} << 20;
constexpr double Patience = 1;  // seconds
constexpr int ReplyPatience = 10;
constexpr int Waiting = 8;

Error problem(const std::filesystem::path& path, const char* what) {
    return Error{path.string() + ": " + what + ": " + std::strerror(errno)};
}

std::optional<sockaddr_un> addressOf(const std::filesystem::path& path) {
    sockaddr_un address{};
    address.sun_family = AF_UNIX;
    const std::string name = path.string();
    if (name.size() >= sizeof address.sun_path) return std::nullopt;
    std::copy(name.begin(), name.end(), std::begin(address.sun_path));
    return address;
}

bool isSameUser(int socket) {
    ucred peer{};
    socklen_t size = sizeof peer;
    return getsockopt(socket, SOL_SOCKET, SO_PEERCRED, &peer, &size) == 0 && peer.uid == getuid();
}

void setTimeouts(int socket, int seconds) {
    const timeval limit{seconds, 0};
    setsockopt(socket, SOL_SOCKET, SO_RCVTIMEO, &limit, sizeof limit);
    setsockopt(socket, SOL_SOCKET, SO_SNDTIMEO, &limit, sizeof limit);
}

// Each text ends with a zero byte; none can hold one.
void append(std::string& message, const std::string& text) {
    message += text.substr(0, text.find('\0'));
    message += '\0';
}

std::vector<std::string> textsOf(const std::string& message) {
    std::vector<std::string> texts;
    for (std::size_t at = 0; at < message.size();) {
        const std::size_t end = message.find('\0', at);
        if (end == std::string::npos) break;
        texts.push_back(message.substr(at, end - at));
        at = end + 1;
    }
    return texts;
}

bool sendAll(int socket, const std::string& message) {
    for (std::size_t sent = 0; sent < message.size();) {
        const ssize_t count = send(socket, message.data() + sent, message.size() - sent, MSG_NOSIGNAL);
        if (count <= 0) return false;
        sent += static_cast<std::size_t>(count);
    }
    return true;
}

// Until the other side has said all.
std::optional<std::string> receiveAll(int socket) {
    std::string message;
    std::array<char, 4096> part{};
    while (message.size() <= LongestReply) {
        const ssize_t count = recv(socket, part.data(), part.size(), 0);
        if (count < 0) return std::nullopt;
        if (count == 0) return message;
        message.append(part.data(), static_cast<std::size_t>(count));
    }
    return std::nullopt;
}

std::optional<CommandReply> replyIn(const std::string& message) {
    const std::vector<std::string> texts = textsOf(message);
    constexpr std::size_t Parts = 3;
    if (texts.size() != Parts) return std::nullopt;
    CommandReply reply{0, texts[1], texts[2]};
    std::from_chars(texts[0].data(), texts[0].data() + texts[0].size(), reply.status);
    return reply;
}

}  // namespace

Result<std::unique_ptr<CommandSocket>> CommandSocket::open(const std::filesystem::path& path, DescriptorLoop& loop,
                                                           Perform perform) {
    const auto address = addressOf(path);
    if (!address) return Error{path.string() + " is too long for the name of a socket"};
    FileDescriptor socket(::socket(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC | SOCK_NONBLOCK, 0));
    if (!socket.isOpen()) return problem(path, "no socket can be made");
    std::error_code ignored;
    std::filesystem::remove(path, ignored);
    const mode_t before = umask(0177);
    const int bound = bind(socket.get(), reinterpret_cast<const sockaddr*>(&*address), sizeof *address);
    umask(before);
    if (bound != 0 || listen(socket.get(), Waiting) != 0) return problem(path, "the socket cannot be opened");
    return std::unique_ptr<CommandSocket>(new CommandSocket(path, std::move(socket), loop, std::move(perform)));
}

CommandSocket::CommandSocket(std::filesystem::path path, FileDescriptor socket, DescriptorLoop& loop, Perform perform)
    : path_(std::move(path)), socket_(std::move(socket)), loop_(loop), perform_(std::move(perform)) {
    source_ = loop_.addSource(socket_.get(), [this] { acceptAll(); });
}

CommandSocket::~CommandSocket() {
    std::error_code ignored;
    std::filesystem::remove(path_, ignored);
}

void CommandSocket::acceptAll() {
    while (true) {
        FileDescriptor socket(accept4(socket_.get(), nullptr, nullptr, SOCK_CLOEXEC | SOCK_NONBLOCK));
        if (!socket.isOpen()) return;
        if (!isSameUser(socket.get())) continue;
        visits_.emplace_back();
        Visit& visit = visits_.back();
        visit.socket = std::move(socket);
        visit.source = loop_.addSource(visit.socket.get(), [this, &visit] { hear(visit); });
        visit.patience = loop_.performAfterDelay(Patience, [this, &visit] { drop(visit); });
    }
}

void CommandSocket::hear(Visit& visit) {
    std::array<char, 4096> part{};
    while (true) {
        const ssize_t count = recv(visit.socket.get(), part.data(), part.size(), 0);
        if (count < 0 && (errno == EAGAIN || errno == EINTR)) return;
        if (count < 0 || visit.received.size() > LongestRequest) return drop(visit);
        if (count == 0) return answer(visit);
        visit.received.append(part.data(), static_cast<std::size_t>(count));
    }
}

void CommandSocket::answer(Visit& visit) {
    std::vector<std::string> texts = textsOf(visit.received);
    // Out of the loop: what is performed may take its time, or run the loop.
    visit.source.end();
    visit.patience.cancel();
    if (!texts.empty()) {
        CommandRequest request{texts.front(), {texts.begin() + 1, texts.end()}};
        const CommandReply reply = perform_(request);
        std::string message;
        for (const std::string& text : {std::to_string(reply.status), reply.output, reply.error}) append(message, text);
        // Whoever asks and does not read gets a part of it, and holds up nobody for longer than a second.
        fcntl(visit.socket.get(), F_SETFL, 0);
        setTimeouts(visit.socket.get(), 1);
        sendAll(visit.socket.get(), message);
    }
    drop(visit);
}

void CommandSocket::drop(const Visit& visit) {
    const auto found = std::ranges::find_if(visits_, [&](const Visit& each) { return &each == &visit; });
    // Not at once: it is this visit's call that drops it.
    if (found == visits_.end()) return;
    auto gone = std::make_shared<std::list<Visit>>();
    gone->splice(gone->begin(), visits_, found);
    gone->front().source.end();
    gone->front().patience.cancel();
    loop_.perform([gone] {});
}

Result<std::optional<CommandReply>> handOver(const std::filesystem::path& socket, const CommandRequest& request) {
    const auto address = addressOf(socket);
    FileDescriptor connection(::socket(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC, 0));
    if (!address || !connection.isOpen()) return std::optional<CommandReply>();
    setTimeouts(connection.get(), ReplyPatience);
    const int connected = connect(connection.get(), reinterpret_cast<const sockaddr*>(&*address), sizeof *address);
    if (connected != 0 || !isSameUser(connection.get())) return std::optional<CommandReply>();
    std::string message;
    append(message, request.folder.string());
    for (const std::string& argument : request.arguments) append(message, argument);
    const bool sent = sendAll(connection.get(), message) && shutdown(connection.get(), SHUT_WR) == 0;
    const auto received = sent ? receiveAll(connection.get()) : std::nullopt;
    auto reply = received ? replyIn(*received) : std::nullopt;
    if (!reply) return Error{"The Plume that is running does not answer."};
    return reply;
}

}  // namespace plume
