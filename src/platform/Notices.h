// Tells the user something in a small window that the desktop shows for a while.
#pragma once

#include <functional>
#include <string>
#include <vector>

namespace plume {

struct Notice {
    struct Button {
        std::string label;
        std::function<void()> pressed;  // called once, on the main thread, if the user presses it
    };

    std::string title;  // a few words
    // One or two sentences of plain text. They say it all: not every desktop shows buttons.
    std::string body;
    std::vector<Button> buttons = {};  // two at most; the first press ends the notice
};

class Notices {
  public:
    virtual ~Notices() = default;
    // From any thread; never waits. Where the desktop shows no notices the port tells the user in another way, and no
    // button is ever pressed; the same goes for a notice with buttons where the desktop has none.
    virtual void show(Notice notice) = 0;
};

}  // namespace plume
