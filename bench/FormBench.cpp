// Forms on a desktop, with the program itself and real keys: how soon they are seen, cold and warm, how soon their text
// arrives, and what the application costs besides.
#include <csignal>
#include <fstream>
#include <string>
#include <vector>

#include "bench/Desk.h"
#include "bench/Figures.h"

namespace plume::bench {

namespace {

using rig::Key;

// The fields that are looked at stand above those that show a cursor.
std::string library() {
    std::string same;
    for (int i = 0; i < 50; ++i) same += "【field:Name width:6】 ";
    std::string many;
    for (int i = 0; i < 200; ++i) many += "【field:F" + std::to_string(i) + " value:v width:4】 ";
    return R"json([{ "abbreviationPrefix": ";", "expandAfter": 2, "expandTrigger": 0, "items": [
      { "abbreviation": "dear", "content": "A letter of some words, and a line\nDear 【field:Name】, thank you." },
      { "abbreviation": "same", "content": ")json" +
           same + R"json(" }, { "abbreviation": "many", "content": "Two hundred fields\n)json" + many +
           R"json(" } ] }])json";
}

pid_t childCalled(pid_t parent, const std::string& wanted) {
    for (const auto& entry : std::filesystem::directory_iterator("/proc")) {
        std::ifstream file(entry.path() / "stat");
        std::string number;
        std::string name;
        std::string state;
        pid_t itsParent = 0;
        if (file >> number >> name >> state >> itsParent && name == wanted && itsParent == parent) {
            return std::stoi(number);
        }
    }
    return 0;
}

double megabytesOf(pid_t process) {
    std::ifstream lines("/proc/" + std::to_string(process) + "/smaps_rollup");
    for (std::string line; std::getline(lines, line);) {
        if (line.starts_with("Pss:")) return std::stod(line.substr(4)) / 1024;
    }
    return 0;
}

class FormDesk : public Desk {
  public:
    FormDesk() : Desk(library(), {}) {}

    void type(const std::string& text) {
        rig().keyboard().type(text);
        rig().keyboard().sync();
    }
    pid_t formProgram() { return childCalled(plume(), "(plume-form)"); }
    bool formHasKeyboard() { return rig().client().activeWindow() != target().window(); }
    void closeForm() {
        tap(Key::Escape);
        settle();
        require(!formHasKeyboard());
        target().clear();
    }
    // Below the title, where the text begins.
    xcb_rectangle_t top(std::uint16_t height = 20) {
        const auto place = rig().client().placeOf(rig().client().activeWindow());
        return {static_cast<std::int16_t>(place.x + 8), static_cast<std::int16_t>(place.y + 8), 160, height};
    }
    // Types all but the last letter, and measures from that one to the picture.
    double untilOpen(const std::string& abbreviation, const xcb_rectangle_t& part, const std::string& expected) {
        type(abbreviation.substr(0, abbreviation.size() - 1));
        settle();
        require(picture(part) != expected);
        return untilShown(part, expected, [&] { type(abbreviation.substr(abbreviation.size() - 1)); });
    }
};

void benchOpening(FormDesk& desk, const std::string& abbreviation, const std::string& figure, bool isCold, int runs) {
    desk.type(abbreviation);
    poll(nullptr, 0, 2'500);
    require(desk.formHasKeyboard());
    const xcb_rectangle_t part = desk.top();
    const std::string expected = desk.picture(part);
    desk.closeForm();
    std::vector<double> times;
    for (int run = 0; run < runs; ++run) {
        if (isCold) {
            const pid_t program = desk.formProgram();
            require(program != 0);
            kill(program, SIGKILL);
            poll(nullptr, 0, 1'000);
            require(desk.formProgram() == 0);
        }
        times.push_back(desk.untilOpen(abbreviation, part, expected));
        poll(nullptr, 0, 700);
        desk.closeForm();
    }
    print(figure, median(std::move(times)), "ms");
}

void benchAccept(FormDesk& desk) {
    constexpr int Runs = 15;
    std::vector<double> times;
    for (int run = 0; run < Runs; ++run) {
        desk.target().clear();
        desk.type(";dear");
        poll(nullptr, 0, 700);
        desk.type("Ada");
        poll(nullptr, 0, 300);
        desk.target().forgetReports();
        const auto pressed = Desk::Clock::now();
        desk.tap(Key::Return);
        const auto change = desk.target().takeChange(Desk::Bound);
        require(change.has_value());
        times.push_back(std::chrono::duration<double, std::milli>(change->time - pressed).count());
        const std::string letter = "A letter of some words, and a line\nDear Ada, thank you.";
        require(desk.target().awaitText(letter) == letter);
    }
    print("form.accept", median(std::move(times)), "ms");
    desk.target().clear();
}

// A letter in the first of fifty fields, until the last line of them shows it.
void benchSync(FormDesk& desk) {
    constexpr int Runs = 15;
    desk.type(";same");
    poll(nullptr, 0, 1'500);
    require(desk.formHasKeyboard());
    const auto place = desk.rig().client().placeOf(desk.rig().client().activeWindow());
    // Without the first line, in which the cursor blinks.
    const xcb_rectangle_t part{static_cast<std::int16_t>(place.x + 8), static_cast<std::int16_t>(place.y + 60),
                               static_cast<std::uint16_t>(place.width - 16), 120};
    const std::string empty = desk.picture(part);
    desk.type("m");
    Desk::settle();
    const std::string filled = desk.picture(part);
    require(filled != empty);
    std::vector<double> times;
    for (int run = 0; run < Runs; ++run) {
        desk.tap(Key::Backspace);
        Desk::settle();
        require(desk.picture(part) == empty);
        times.push_back(desk.untilShown(part, filled, [&] { desk.type("m"); }));
        Desk::settle();
    }
    print("form.sync", median(std::move(times)), "ms");
    desk.closeForm();
}

}  // namespace

}  // namespace plume::bench

int main() {
    using namespace plume::bench;
    FormDesk desk;
    const double before = megabytesOf(desk.plume());
    benchOpening(desk, ";dear", "form.cold", true, 11);
    benchOpening(desk, ";dear", "form.warm", false, 21);
    benchOpening(desk, ";many", "form.fields200.open", false, 11);
    benchAccept(desk);
    benchSync(desk);
    print("form.program.pss", megabytesOf(desk.formProgram()), "MB");
    kill(desk.formProgram(), SIGKILL);
    poll(nullptr, 0, 1'000);
    print("form.idle.pss", megabytesOf(desk.plume()), "MB");
    print("form.idle.pss.before", before, "MB");
}
