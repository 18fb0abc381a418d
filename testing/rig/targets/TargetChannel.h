#pragma once

#include <cstdint>
#include <functional>
#include <string>

namespace plume::target {

// What a test asks of the text that a target program holds. Texts are UTF-8.
struct Editor {
    std::function<std::string()> text;
    std::function<void(const std::string&)> setText;
    std::function<void(bool)> showPassword = {};  // a window of its own with a field for a password, in front
};

// A target program's line to the test that started it: one JSON object a line in both directions. What happens is told
// with the CLOCK_MONOTONIC time, in nanoseconds, at which this program noticed it; positions and lengths count
// characters.
class TargetChannel {
  public:
    // Ends the program with a message when the test's socket cannot be reached.
    TargetChannel(const char* socketPath, Editor editor);

    int descriptor() const { return socket_; }

    void reportReady(unsigned long window);
    void reportText(int position, int removed, const std::string& inserted, int length);
    void reportPasted(int length);

    // Answers the requests that have arrived; false once the test has closed the line and the program should end.
    bool answerRequests();

  private:
    void write(const std::string& line) const;
    void answer(const std::string& request);

    int socket_;
    Editor editor_;
    std::string unread_;
};

// Characters in UTF-8 text.
int countCharacters(const std::string& text);

}  // namespace plume::target
