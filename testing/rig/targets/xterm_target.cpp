// The program inside an xterm that tells a test what the terminal gives it. Argument: the test's socket.

#include <poll.h>
#include <termios.h>
#include <unistd.h>

#include <algorithm>
#include <array>
#include <cstdlib>
#include <memory>
#include <string>

#include "testing/rig/targets/TargetChannel.h"
#include "testing/rig/targets/TerminalLine.h"

namespace {

using plume::target::TargetChannel;
using plume::target::TerminalLine;

void show(const std::string& bytes) {
    for (std::size_t done = 0; done < bytes.size();) {
        const ssize_t count = write(STDOUT_FILENO, bytes.data() + done, bytes.size() - done);
        if (count <= 0) return;
        done += static_cast<std::size_t>(count);
    }
}

std::string withTerminalNewlines(const std::string& text) {
    std::string converted;
    for (const char byte : text) converted += byte == '\n' ? std::string("\r\n") : std::string(1, byte);
    return converted;
}

// The keys as they come, without the terminal line's own editing.
class RawTerminal {
  public:
    RawTerminal() {
        tcgetattr(STDIN_FILENO, &before_);
        termios raw = before_;
        cfmakeraw(&raw);
        tcsetattr(STDIN_FILENO, TCSANOW, &raw);
        show("\x1b[?2004h");  // bracket pastes
    }
    ~RawTerminal() { tcsetattr(STDIN_FILENO, TCSANOW, &before_); }
    RawTerminal(const RawTerminal&) = delete;
    RawTerminal& operator=(const RawTerminal&) = delete;

  private:
    termios before_{};
};

void serve(TargetChannel& channel, TerminalLine& line) {
    while (true) {
        std::array<pollfd, 2> sources{{{STDIN_FILENO, POLLIN, 0}, {channel.descriptor(), POLLIN, 0}}};
        if (poll(sources.data(), sources.size(), -1) < 0) return;
        if (sources[0].revents != 0) {
            std::array<char, 4096> buffer{};
            const ssize_t count = read(STDIN_FILENO, buffer.data(), buffer.size());
            if (count <= 0) return;
            line.read(std::string(buffer.data(), static_cast<std::size_t>(count)));
        }
        if (sources[1].revents != 0 && !channel.answerRequests()) return;
    }
}

}  // namespace

int main(int argc, char** argv) {
    if (argc < 2) return 2;
    std::unique_ptr<TargetChannel> channel;
    TerminalLine line({.changed =
                           [&](int position, int removed, const std::string& inserted) {
                               channel->reportText(position, removed, inserted, line.length());
                               const bool appended = removed == 0 && line.isAtEnd();
                               show(withTerminalNewlines(appended ? inserted : "\x1b[2J\x1b[H" + line.text()));
                           },
                       .pasted = [&] { channel->reportPasted(line.length()); }});
    channel = std::make_unique<TargetChannel>(
        argv[1],
        plume::target::Editor{[&] { return line.text(); }, [&](const std::string& text) { line.setText(text); }});
    const RawTerminal terminal;
    const char* window = std::getenv("WINDOWID");
    channel->reportReady(window != nullptr ? std::strtoul(window, nullptr, 10) : 0);
    serve(*channel, line);
    return 0;
}
