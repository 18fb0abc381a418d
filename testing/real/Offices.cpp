#include "testing/real/CopyWatch.h"
#include "testing/real/RealProgram.h"
#include "testing/rig/Deadline.h"
#include "testing/rig/SelectionClients.h"

namespace plume::real {

namespace {

using rig::Key;

// Without the windows of a first start.
constexpr const char* Settings = R"(<?xml version="1.0" encoding="UTF-8"?>
<oor:items xmlns:oor="http://openoffice.org/2001/registry" xmlns:xs="http://www.w3.org/2001/XMLSchema">
<item oor:path="/org.openoffice.Office.Common/Misc"><prop oor:name="ShowTipOfTheDay" oor:op="fuse"><value>false</value></prop></item>
<item oor:path="/org.openoffice.Office.Common/Misc"><prop oor:name="FirstRun" oor:op="fuse"><value>false</value></prop></item>
<item oor:path="/org.openoffice.Setup/Product"><prop oor:name="ooSetupLastVersion" oor:op="fuse"><value>7.4</value></prop></item>
<item oor:path="/org.openoffice.Office.Impress/Misc/NewDoc"><prop oor:name="AutoPilot" oor:op="fuse"><value>false</value></prop></item>
</oor:items>
)";

RealProgram office(const std::string& part, const std::string& backEnd, std::vector<Place> places) {
    return {part + " (" + backEnd + ")",
            "libreoffice-core",
            "libreoffice",
            {"soffice", "--norestore", "--nologo", "-env:UserInstallation=file://{}/profile",
             "--" + std::string(1, static_cast<char>(part[0] + ('a' - 'A'))) + part.substr(1)},
            std::move(places),
            {{"profile/user/registrymodifications.xcu", Settings}},
            {"SAL_USE_VCLPLUGIN=" + backEnd}};
}

// They do much of what keys say behind what is typed after it, and tell nobody when.
constexpr rig::Milliseconds Settling{200};
constexpr rig::Milliseconds Starting{3'000};
constexpr rig::Milliseconds CutBound{2'000};
constexpr rig::Milliseconds ClearBound{30'000};

void pause(rig::Milliseconds time) {
    rig::waitUntil([] { return false; }, time);
}

void press(rig::DesktopRig& rig, Key key) {
    rig.keyboard().tap(key);
    rig.keyboard().sync();
    pause(Settling);
}

// All that there is, and a letter at the caret; empty when nothing was cut.
std::string cutAll(rig::DesktopRig& rig, const std::string& letter) {
    const std::string display = rig.server().display();
    rig.client().emptySelection("CLIPBOARD");
    CopyWatch watch(display);
    rig.keyboard().type(letter);
    rig.keyboard().chord({Key::LeftControl}, U'a');
    pause(Settling);
    rig.keyboard().chord({Key::LeftControl}, U'x');
    if (!watch.awaitOwner(CutBound, [](xcb_window_t owner) { return owner != XCB_WINDOW_NONE; })) return {};
    try {
        const auto cut = rig::SelectionRequestor(display).request("CLIPBOARD", "UTF8_STRING");
        return cut ? cut->bytes : std::string();
    } catch (const rig::RigError&) {
        return {};  // Writer (gtk3) has been seen to leave a question without an answer
    }
}

// Everything that was to be done before is done, and nothing is left, when a single letter is all that can be cut.
void empty(rig::DesktopRig& rig) {
    const std::string letter = "Q";
    rig::waitUntil([&] { return cutAll(rig, letter) == letter; }, ClearBound);
}

Place document() {
    return {.offers = {Needs::Lines}, .settling = Settling, .clear = empty};
}

Place cell() {
    const auto edit = [](rig::DesktopRig& rig) {
        for (const Key key : {Key::Escape, Key::Delete, Key::F2}) press(rig, key);
        empty(rig);
    };
    return {.settling = Settling, .clear = edit};
}

// Not edited yet: what is typed replaces it, and the rest of the cell above it is proposed.
Place cellBelow() {
    const auto fillAbove = [](rig::DesktopRig& rig) {
        press(rig, Key::Escape);
        rig.keyboard().chord({Key::LeftControl}, Key::Home);
        pause(Settling);
        rig.keyboard().type("btwenty");
        press(rig, Key::Return);
        press(rig, Key::Delete);
    };
    return {.name = "cell, proposing", .offers = {Needs::Proposals}, .settling = Settling, .clear = fillAbove};
}

// The text of the slide; the title moves the caret to its start when several lines are pasted. Outside of it, select
// all would mean the frames, and they would go.
Place slide() {
    const auto edit = [](rig::DesktopRig& rig) {
        pause(Starting);
        for (const Key key : {Key::Escape, Key::Escape, Key::Tab, Key::Tab, Key::F2}) press(rig, key);
    };
    return {.offers = {Needs::Lines}, .settling = Settling, .enter = edit, .clear = empty};
}

}  // namespace

std::vector<RealProgram> offices() {
    std::vector<RealProgram> programs;
    for (const std::string backEnd : {"gtk3", "kf5"}) {
        programs.push_back(office("Writer", backEnd, {document()}));
        programs.push_back(office("Calc", backEnd, {cell(), cellBelow()}));
        programs.push_back(office("Impress", backEnd, {slide()}));
    }
    return programs;
}

}  // namespace plume::real
