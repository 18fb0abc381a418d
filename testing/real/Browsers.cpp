#include "testing/real/RealProgram.h"

namespace plume::real {

namespace {

using rig::Key;

// Shows in its title what stands in the field that has the focus.
constexpr const char* Page = R"(<!doctype html><meta charset="utf-8"><title>[]</title>
<textarea id="area" rows="6" cols="100" autofocus></textarea>
<div id="rich" contenteditable style="border: 1px solid; min-height: 6em"></div>
<p><input id="password" type="password"></p>
<script>
function show() {
    const field = document.activeElement;
    const text = field.value === undefined ? field.innerText : field.value;
    document.title = '[' + text.replace(/[%\[\]\n]/g, encodeURIComponent) + ']';
}
for (const event of ['input', 'focusin']) document.addEventListener(event, show);
</script>
)";

constexpr const char* FirefoxSettings = R"(
user_pref("app.normandy.enabled", false);
user_pref("browser.aboutwelcome.enabled", false);
user_pref("browser.shell.checkDefaultBrowser", false);
user_pref("browser.startup.homepage_override.mstone", "ignore");
user_pref("datareporting.policy.dataSubmissionEnabled", false);
user_pref("network.dns.localDomains", "btw.example");
user_pref("toolkit.telemetry.reportingpolicy.firstRun", false);
)";

void pressTab(rig::DesktopRig& rig) {
    rig.keyboard().tap(Key::Tab);
    rig.keyboard().sync();
}

void enterAddressBar(rig::DesktopRig& rig) {
    rig.keyboard().chord({Key::LeftControl}, U'l');
}

std::vector<Place> places() {
    return {{.name = "text area", .reading = Reading::Title, .offers = {Needs::Lines}},
            {.name = "rich field", .reading = Reading::Title, .offers = {Needs::Lines}, .enter = pressTab},
            {.name = "password field", .reading = Reading::Title, .offers = {Needs::Password}, .enter = pressTab},
            {.name = "address bar", .enter = enterAddressBar}};
}

}  // namespace

std::vector<RealProgram> browsers() {
    return {
        {"Firefox",
         "firefox-esr",
         "irefox",
         {"firefox-esr", "--no-remote", "--profile", "{}/profile", "file://{}/page.html"},
         places(),
         {{"page.html", Page}, {"profile/user.js", FirefoxSettings}}},
        {"Chromium",
         "chromium",
         "hromium",
         {"chromium", "--no-sandbox", "--no-first-run", "--no-default-browser-check", "--password-store=basic",
          "--disable-gpu", "--test-type", "--user-data-dir={}/profile",
          "--host-resolver-rules=MAP btw.example 127.0.0.1", "file://{}/page.html"},
         places(),
         {{"page.html", Page}}},
    };
}

}  // namespace plume::real
