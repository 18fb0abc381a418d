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
<item oor:path="/org.openoffice.Office.Impress/Misc/Start"><prop oor:name="EnableSdremote" oor:op="fuse"><value>false</value></prop></item>
<item oor:path="/org.openoffice.Office.Impress/Misc"><prop oor:name="StartWithTemplate" oor:op="fuse"><value>false</value></prop></item>
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

// These programs run keys that erase behind what is typed after them: nothing tells when they have.
void awaitErasing(rig::DesktopRig& rig) {
    rig.keyboard().sync();
    rig::waitUntil([] { return false; }, rig::Milliseconds(150));
}

void eraseAll(rig::DesktopRig& rig) {
    rig.keyboard().chord({Key::LeftControl}, U'a');
    rig.keyboard().tap(Key::Backspace);
    awaitErasing(rig);
}

Place document() {
    return {.offers = {Needs::Lines}, .clear = eraseAll};
}

Place cell() {
    const auto edit = [](rig::DesktopRig& rig) {
        rig.keyboard().tap(Key::Escape);
        rig.keyboard().tap(Key::Delete);
        rig.keyboard().tap(static_cast<Key>(68));  // F2
        awaitErasing(rig);
    };
    return {.clear = edit};
}

Place slide() {
    const auto edit = [](rig::DesktopRig& rig) {
        rig.keyboard().tap(Key::Tab);
        rig.keyboard().tap(static_cast<Key>(68));  // F2
        awaitErasing(rig);
    };
    return {.offers = {Needs::Lines}, .enter = edit, .clear = eraseAll};
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
