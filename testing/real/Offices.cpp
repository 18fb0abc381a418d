#include "testing/real/RealProgram.h"
#include "testing/rig/Deadline.h"

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

RealProgram office(const std::string& part, const std::string& backEnd, Place place) {
    return {part + " (" + backEnd + ")",
            "libreoffice-core",
            "libreoffice",
            {"soffice", "--norestore", "--nologo", "-env:UserInstallation=file://{}/profile",
             "--" + std::string(1, static_cast<char>(part[0] + ('a' - 'A'))) + part.substr(1)},
            {std::move(place)},
            {{"profile/user/registrymodifications.xcu", Settings}},
            {"SAL_USE_VCLPLUGIN=" + backEnd}};
}

// They do what keys say that erase or move behind what is typed after them.
constexpr rig::Milliseconds Settling{200};

void pause(rig::Milliseconds time) {
    rig::waitUntil([] { return false; }, time);
}

void press(rig::DesktopRig& rig, Key key) {
    rig.keyboard().tap(key);
    rig.keyboard().sync();
}

Place document() {
    return {.offers = {Needs::Lines}, .settling = Settling};
}

Place cell() {
    const auto edit = [](rig::DesktopRig& rig) {
        press(rig, Key::Escape);
        press(rig, Key::Delete);
        press(rig, Key::F2);
    };
    return {.settling = Settling, .clear = edit};
}

// The title of the slide, entered anew each time. While it is not, select all means the frames, and they would go.
Place slide() {
    const auto edit = [](rig::DesktopRig& rig) {
        for (const Key key : {Key::Escape, Key::Escape, Key::Tab, Key::F2}) {
            press(rig, key);
            pause(Settling);
        }
        rig.keyboard().chord({Key::LeftControl}, U'a');
        pause(Settling);
        press(rig, Key::Backspace);
    };
    const auto start = [](rig::DesktopRig&) {
        constexpr rig::Milliseconds Starting{3'000};
        pause(Starting);
    };
    return {.offers = {Needs::Lines}, .settling = Settling, .enter = start, .clear = edit};
}

}  // namespace

std::vector<RealProgram> offices() {
    std::vector<RealProgram> programs;
    for (const std::string backEnd : {"gtk3", "kf5"}) {
        programs.push_back(office("Writer", backEnd, document()));
        programs.push_back(office("Calc", backEnd, cell()));
        programs.push_back(office("Impress", backEnd, slide()));
    }
    return programs;
}

}  // namespace plume::real
