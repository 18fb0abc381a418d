#include "testing/real/RealProgram.h"
#include "testing/rig/Deadline.h"

namespace plume::real {

namespace {

using rig::Key;

// Shows in its title what stands in the field that has the focus, and whether that takes a password.
constexpr const char* Page = R"(<!doctype html><meta charset="utf-8"><title>[]</title>
<textarea id="area" rows="6" cols="100" autofocus></textarea>
<div id="rich" contenteditable style="border: 1px solid; min-height: 6em"></div>
<p><input id="password" type="password"></p>
<script>
function show() {
    const field = document.activeElement;
    const text = field.value === undefined ? field.innerText : field.value;
    const mark = field.type === 'password' ? '*' : '';
    document.title = mark + '[' + text.replace(/[%\[\]\n]/g, encodeURIComponent) + ']';
}
document.addEventListener('keydown', event => {
    const field = {F2: 'rich', Insert: 'password'}[event.key];
    if (field) document.getElementById(field).focus();
});
for (const event of ['input', 'focusin']) document.addEventListener(event, show);
</script>
)";

constexpr const char* FirefoxSettings = R"(
user_pref("app.normandy.enabled", false);
user_pref("browser.aboutwelcome.enabled", false);
user_pref("browser.shell.checkDefaultBrowser", false);
user_pref("browser.startup.homepage_override.mstone", "ignore");
user_pref("datareporting.policy.dataSubmissionEnabled", false);
user_pref("dom.security.https_first", false);
user_pref("network.dns.localDomains", "btwexample.test");
user_pref("toolkit.telemetry.reportingpolicy.firstRun", false);
)";

// The page's keys for its fields.
void enterRichField(rig::DesktopRig& rig) {
    rig.keyboard().tap(Key::F2);
    rig.keyboard().sync();
}

void enterPasswordField(rig::DesktopRig& rig) {
    rig.keyboard().tap(Key::Insert);
    rig.keyboard().sync();
}

void enterAddressBar(rig::DesktopRig& rig) {
    rig.keyboard().chord({Key::LeftControl}, U'l');
}

// Chromium's may have the focus in its page.
void openTab(rig::DesktopRig& rig) {
    constexpr rig::Milliseconds Opening{500};
    rig.keyboard().chord({Key::LeftControl}, U't');
    rig::waitUntil([] { return false; }, Opening);
    enterAddressBar(rig);
}

std::vector<Place> places() {
    return {
        {.name = "text area", .offers = {Needs::Lines}},
        {.name = "rich field", .offers = {Needs::Lines}, .enter = enterRichField},
        {.name = "password field", .reading = Reading::Title, .offers = {Needs::Password}, .enter = enterPasswordField},
        {.name = "address bar", .enter = enterAddressBar},
        {.name = "address bar, proposing",
         .offers = {Needs::Proposals},
         .enter = openTab,
         .visited = "http://btwexample.test:{port}/"}};
}

}  // namespace

std::vector<RealProgram> browsers() {
    return {
        {"Firefox",
         "firefox-esr",
         "irefox",
         {"firefox-esr", "--no-remote", "--profile", "{}/profile", "file://{}/page.html"},
         places(),
         {{"page.html", Page}, {"index.html", "<title>visited</title>"}, {"profile/user.js", FirefoxSettings}},
         {},
         true},
        {"Chromium",
         "chromium",
         "hromium",
         {"chromium", "--no-sandbox", "--no-first-run", "--no-default-browser-check", "--password-store=basic",
          "--disable-gpu", "--test-type", "--user-data-dir={}/profile",
          "--host-resolver-rules=MAP btwexample.test 127.0.0.1", "file://{}/page.html"},
         places(),
         {{"page.html", Page}, {"index.html", "<title>visited</title>"}},
         {},
         true},
    };
}

}  // namespace plume::real
