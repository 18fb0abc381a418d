#include "testing/rig/targets/TargetChannel.h"

#include <sys/socket.h>
#include <sys/un.h>
#include <unistd.h>

#include <algorithm>
#include <array>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <ctime>
#include <nlohmann/json.hpp>

namespace plume::target {

namespace {

using nlohmann::json;

std::int64_t monotonicNanoseconds() {
    timespec now{};
    clock_gettime(CLOCK_MONOTONIC, &now);
    return std::int64_t{now.tv_sec} * 1'000'000'000 + now.tv_nsec;
}

// A terminal may hand over bytes that are not UTF-8; the test then sees replacement characters.
std::string lineOf(const json& object) {
    return object.dump(-1, ' ', false, json::error_handler_t::replace) + '\n';
}

}  // namespace

TargetChannel::TargetChannel(const char* socketPath, Editor editor)
    : socket_(socket(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC, 0)), editor_(std::move(editor)) {
    sockaddr_un address{};
    address.sun_family = AF_UNIX;
    std::strncpy(address.sun_path, socketPath, sizeof address.sun_path - 1);
    if (connect(socket_, reinterpret_cast<const sockaddr*>(&address), sizeof address) != 0) {
        std::perror("cannot reach the test");
        std::exit(1);
    }
}

void TargetChannel::reportReady(unsigned long window) {
    write(lineOf({{"event", "ready"}, {"time", monotonicNanoseconds()}, {"window", window}}));
}

void TargetChannel::reportText(int position, int removed, const std::string& inserted, int length) {
    write(lineOf({{"event", "text"},
                  {"time", monotonicNanoseconds()},
                  {"position", position},
                  {"removed", removed},
                  {"inserted", inserted},
                  {"length", length}}));
}

void TargetChannel::reportPasted(int length) {
    write(lineOf({{"event", "pasted"}, {"time", monotonicNanoseconds()}, {"length", length}}));
}

bool TargetChannel::answerRequests() {
    std::array<char, 65536> buffer{};
    const ssize_t count = read(socket_, buffer.data(), buffer.size());
    if (count <= 0) return false;
    unread_.append(buffer.data(), static_cast<std::size_t>(count));
    for (auto end = unread_.find('\n'); end != std::string::npos; end = unread_.find('\n')) {
        answer(unread_.substr(0, end));
        unread_.erase(0, end + 1);
    }
    return true;
}

void TargetChannel::answer(const std::string& request) {
    const auto object = json::parse(request);
    if (object.at("request") == "set") editor_.setText(object.at("text"));
    if (object.at("request") == "password") editor_.showPassword(object.at("shown"));
    write(lineOf({{"event", "answer"}, {"time", monotonicNanoseconds()}, {"text", editor_.text()}}));
}

void TargetChannel::write(const std::string& line) const {
    std::size_t done = 0;
    while (done < line.size()) {
        const ssize_t count = send(socket_, line.data() + done, line.size() - done, MSG_NOSIGNAL);
        if (count <= 0) std::exit(0);  // the test has gone
        done += static_cast<std::size_t>(count);
    }
}

int countCharacters(const std::string& text) {
    return static_cast<int>(std::ranges::count_if(text, [](char byte) { return (byte & 0xC0) != 0x80; }));
}

}  // namespace plume::target
