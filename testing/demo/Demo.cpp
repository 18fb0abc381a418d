// Shows Plume at work: a private desktop with a window manager and three programs, Plume with its sample library, and
// abbreviations typed on a keyboard. Prints what arrived, writes a picture of the screen, and ends with 0 only when
// every row is right.
//   plume_demo PICTURE.png
#include <ctime>
#include <exception>
#include <iomanip>
#include <iostream>
#include <string>
#include <vector>

#include "testing/rig/PlumeProgram.h"
#include "testing/rig/Screenshot.h"

#include <sys/utsname.h>

namespace plume::rig {

namespace {

struct Row {
    std::string typed;
    std::string expected;
};

std::string today() {
    const std::time_t now = std::time(nullptr);
    std::tm local{};
    localtime_r(&now, &local);
    char text[16];
    return {text, std::strftime(text, sizeof text, "%Y-%m-%d", &local)};
}

std::string hostName() {
    utsname names{};
    uname(&names);
    return names.nodename;
}

std::vector<Row> rows() {
    return {
        {"btw ", "by the way "},
        {"Btw ", "By the way "},
        {"ASAP ", "AS SOON AS POSSIBLE "},
        {";me", "jo.doe@example.com"},
        {";->", "→"},
        {";shrug", "¯\\_(ツ)_/¯"},
        {";date", today()},
        {";boldtext in the middle", "<b>text in the middle</b>"},
        {";host", hostName()},
        {";warn", "Important: please answer by Friday."},
        {";lorem",
         "Lorem ipsum dolor sit amet, consectetur adipiscing elit, sed do eiusmod tempor incididunt ut labore et "
         "dolore magna aliqua."},
    };
}

std::string quoted(const std::string& text) {
    constexpr std::size_t Shown = 44;
    const std::string start = text.size() > Shown ? text.substr(0, Shown - 3) + "..." : text;
    return '"' + start + '"';
}

// Left-aligned in a column, counting characters.
std::string column(const std::string& text, std::size_t width) {
    std::size_t characters = 0;
    for (const char byte : text) characters += (static_cast<unsigned char>(byte) & 0xC0) != 0x80 ? 1 : 0;
    return text + std::string(characters < width ? width - characters : 0, ' ') + "  ";
}

void print(const std::string& program, const Row& row, const Expansion& expansion) {
    std::cout << column(program, 8) << column(quoted(row.typed), 26) << column(quoted(row.expected), 46)
              << column(expansion.isRight ? "as expected" : quoted(expansion.got), 12) << std::fixed
              << std::setprecision(1) << std::setw(7) << expansion.milliseconds << '\n';
}

// How many rows were wrong.
int showIn(DesktopRig& rig, TargetProgram& target) {
    int wrong = 0;
    for (const Row& row : rows()) {
        const Expansion expansion = typeAndAwait(rig, target, row.typed, row.expected);
        print(nameOf(target.kind()), row, expansion);
        wrong += expansion.isRight ? 0 : 1;
    }
    return wrong;
}

// What the picture shows.
void leaveSomethingToSee(DesktopRig& rig, TargetProgram& target) {
    typeAndAwait(rig, target, "Hello, btw ", "Hello, by the way ");
    rig.keyboard().type("today is ;date ;-> all is well ;ok");
}

int demonstrate(const std::string& picture) {
    DesktopRig rig;
    PlumeProgram plume(rig, "");
    std::cout << "Plume was ready after " << std::fixed << std::setprecision(0) << plume.secondsToReady() * 1000
              << " ms.\n\n"
              << column("program", 8) << column("typed", 26) << column("expected", 46) << column("got", 12)
              << "     ms\n";
    int wrong = 0;
    std::vector<std::unique_ptr<TargetProgram>> targets;
    for (const TargetKind kind : {TargetKind::GtkTextView, TargetKind::QtTextEdit, TargetKind::Xterm}) {
        targets.push_back(rig.startTarget(kind));
        wrong += showIn(rig, *targets.back());
        leaveSomethingToSee(rig, *targets.back());
    }
    rig.keyboard().sync();
    targets.back()->awaitText("", Milliseconds(500));
    writeScreenshot(rig.client(), picture);
    std::cout << '\n' << (wrong == 0 ? "Every row is right." : std::to_string(wrong) + " rows are wrong.") << '\n';
    if (wrong > 0) std::cout << plume.process().logTail();
    return wrong == 0 ? 0 : 1;
}

}  // namespace

}  // namespace plume::rig

int main(int argc, char** argv) {
    try {
        return plume::rig::demonstrate(argc > 1 ? argv[1] : "plume-demo.png");
    } catch (const std::exception& problem) {
        std::cerr << "plume demo: " << problem.what() << '\n';
        return 1;
    }
}
