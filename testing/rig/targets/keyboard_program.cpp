// A program with a keyboard tap and a watchdog, as Plume is one, that goes wrong on demand:
//   keyboard_program <file> <seconds>
// 'h' makes the tap's listener hang for so long, 'l' makes it loop for ever, and 's' is swallowed. The file gets a
// line for everything that happens: "ready" with the watchdog's process, and "disabled".

#include <unistd.h>

#include <fstream>
#include <iostream>
#include <thread>

#include "testing/rig/KeyboardPort.h"

int main(int /*count*/, char** arguments) {
    using plume::TapEvent;
    using plume::rig::KeyboardPort;
    std::ofstream report(arguments[1], std::ios::app);
    const std::chrono::seconds hang(std::stoi(arguments[2]));
    const auto decide = [hang](const TapEvent& event) {
        if (event.type != TapEvent::Type::KeyDown) return false;
        if (event.string == u"h") std::this_thread::sleep_for(hang);
        volatile bool forEver = true;
        while (event.string == u"l" && forEver) continue;
        return event.string == u"s";
    };
    try {
        KeyboardPort port("",
                          {.decide = decide, .watchdog = true, .disabled = [&] { report << "disabled" << std::endl; }});
        report << "ready " << port.watchdog().process() << std::endl;
        pause();
    } catch (const std::exception& problem) {
        std::cerr << problem.what() << '\n';
        return 1;
    }
}
