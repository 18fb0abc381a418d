#include "testing/rig/TargetProgram.h"

#include <sys/socket.h>
#include <sys/un.h>

#include <algorithm>
#include <array>
#include <nlohmann/json.hpp>

#include "testing/rig/Deadline.h"

namespace plume::rig {

namespace {

using nlohmann::json;

constexpr Milliseconds StartBound{20'000};
constexpr Milliseconds AnswerBound{10'000};

FileDescriptor listenAt(const std::filesystem::path& path) {
    FileDescriptor listener(socket(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC, 0));
    sockaddr_un address{};
    address.sun_family = AF_UNIX;
    if (path.native().size() >= sizeof address.sun_path) throw RigError("too long for a socket: " + path.string());
    path.native().copy(address.sun_path, sizeof address.sun_path);
    unlink(path.c_str());
    if (bind(listener.get(), reinterpret_cast<const sockaddr*>(&address), sizeof address) != 0 ||
        listen(listener.get(), 1) != 0) {
        throw RigError("cannot listen at " + path.string());
    }
    return listener;
}

// The target programs are built next to the test program.
std::filesystem::path builtProgram(const std::string& name) {
    return std::filesystem::read_symlink("/proc/self/exe").parent_path() / name;
}

std::vector<std::string> commandOf(TargetKind kind, const std::string& socket) {
    switch (kind) {
        case TargetKind::GtkTextView:
            return {builtProgram("gtk_target"), socket};
        case TargetKind::QtTextEdit:
            return {builtProgram("qt_target"), socket};
        case TargetKind::Xterm:
            return {"xterm", "-e", builtProgram("xterm_target"), socket};
    }
    throw RigError("no such target");
}

int countCharacters(const std::string& text) {
    return static_cast<int>(std::ranges::count_if(text, [](char byte) { return (byte & 0xC0) != 0x80; }));
}

}  // namespace

std::string nameOf(TargetKind kind) {
    switch (kind) {
        case TargetKind::GtkTextView:
            return "GTK";
        case TargetKind::QtTextEdit:
            return "Qt";
        case TargetKind::Xterm:
            return "xterm";
    }
    return "?";
}

TargetProgram::TargetProgram(TargetKind kind, DesktopSession& session, XClient& client,
                             const std::filesystem::path& socket)
    : kind_(kind), client_(client) {
    const FileDescriptor listener = listenAt(socket);
    const bool terminal = kind == TargetKind::Xterm;
    process_ = session.start(commandOf(kind, socket), terminal ? "xterm" : "(built with PLUME_DESKTOP_TESTS)");
    if (!Deadline(StartBound).waitReadable(listener.get())) throw failure("did not connect");
    line_ = FileDescriptor(accept4(listener.get(), nullptr, nullptr, SOCK_CLOEXEC));
    reader_ = std::thread([this] { readLines(); });
    try {
        std::unique_lock lock(mutex_);
        told_.wait_for(lock, StartBound, [this] { return ready_ || ended_; });
        if (!ready_) throw failure("did not show its window");
        window_ = *ready_;
        lock.unlock();
        client_.await("showing the " + nameOf(kind) + " target", StartBound,
                      [this] { return std::ranges::count(client_.managedWindows(), window_) > 0; });
        client_.activate(window_);
    } catch (...) {
        shutdown(line_.get(), SHUT_RDWR);
        reader_.join();
        throw;
    }
}

TargetProgram::~TargetProgram() {
    shutdown(line_.get(), SHUT_RDWR);
    reader_.join();
    process_.reset();
    // The window manager gives the focus to somebody else when it notices: later it would take it from the next
    // program.
    try {
        client_.await("the end of the target's window", Milliseconds(2'000), [this] {
            const auto managed = client_.managedWindows();
            return std::ranges::find(managed, window_) == managed.end();
        });
    } catch (const RigError&) {
        // The window manager or the server may have ended before it.
    }
}

std::string TargetProgram::text() {
    return ask(json{{"request", "text"}}.dump());
}

void TargetProgram::setText(const std::string& text) {
    ask(json{{"request", "set"}, {"text", text}}.dump());
    const std::scoped_lock lock(mutex_);
    changes_.clear();
}

void TargetProgram::showPassword(bool shown) {
    ask(json{{"request", "password"}, {"shown", shown}}.dump());
}

std::optional<TextChange> TargetProgram::takeChange(Milliseconds bound) {
    std::unique_lock lock(mutex_);
    told_.wait_for(lock, bound, [this] { return !changes_.empty() || ended_; });
    if (changes_.empty()) return std::nullopt;
    TextChange change = std::move(changes_.front());
    changes_.pop_front();
    return change;
}

std::string TargetProgram::awaitText(const std::string& expected, Milliseconds bound) {
    const int length = countCharacters(expected);
    const auto end = std::chrono::steady_clock::now() + bound;
    std::string last = text();
    while (last != expected) {
        const auto left = std::chrono::duration_cast<Milliseconds>(end - std::chrono::steady_clock::now());
        const auto change = takeChange(std::max(left, Milliseconds(0)));
        if (!change) return text();
        if (change->length == length) last = text();  // asking for a long text after every key would slow the target
    }
    return last;
}

bool TargetProgram::awaitPaste(Milliseconds bound) {
    std::unique_lock lock(mutex_);
    if (!told_.wait_for(lock, bound, [this] { return pastes_ > 0 || ended_; }) || pastes_ == 0) return false;
    --pastes_;
    return true;
}

void TargetProgram::forgetReports() {
    const std::scoped_lock lock(mutex_);
    changes_.clear();
    pastes_ = 0;
}

std::string TargetProgram::ask(const std::string& request) {
    const std::string line = request + '\n';
    for (std::size_t done = 0; done < line.size();) {
        const ssize_t count = send(line_.get(), line.data() + done, line.size() - done, MSG_NOSIGNAL);
        if (count <= 0) throw failure("has gone");
        done += static_cast<std::size_t>(count);
    }
    std::unique_lock lock(mutex_);
    told_.wait_for(lock, AnswerBound, [this] { return !answers_.empty() || ended_; });
    if (answers_.empty()) throw failure("does not answer");
    std::string answer = std::move(answers_.front());
    answers_.pop_front();
    return answer;
}

void TargetProgram::readLines() {
    std::string unread;
    std::array<char, 65536> buffer{};
    while (true) {
        const ssize_t count = read(line_.get(), buffer.data(), buffer.size());
        if (count <= 0) break;
        unread.append(buffer.data(), static_cast<std::size_t>(count));
        std::size_t start = 0;
        for (auto end = unread.find('\n'); end != std::string::npos; end = unread.find('\n', start)) {
            takeLine(unread.substr(start, end - start));
            start = end + 1;
        }
        unread.erase(0, start);
    }
    const std::scoped_lock lock(mutex_);
    ended_ = true;
    told_.notify_all();
}

void TargetProgram::takeLine(const std::string& line) {
    const auto told = json::parse(line);
    const std::string event = told.at("event");
    const std::scoped_lock lock(mutex_);
    if (event == "text") {
        const std::chrono::nanoseconds time(told.at("time").get<std::int64_t>());
        changes_.push_back(
            {MonotonicTime(time), told.at("position"), told.at("removed"), told.at("inserted"), told.at("length")});
    } else if (event == "pasted") {
        ++pastes_;
    } else if (event == "answer") {
        answers_.push_back(told.at("text"));
    } else if (event == "ready") {
        ready_ = told.at("window").get<xcb_window_t>();
    }
    told_.notify_all();
}

RigError TargetProgram::failure(const std::string& what) const {
    return RigError("the " + nameOf(kind_) + " target " + what + ":\n" + process_->logTail());
}

}  // namespace plume::rig
