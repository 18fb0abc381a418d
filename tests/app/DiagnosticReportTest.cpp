#include "app/DiagnosticReport.h"

#include <gtest/gtest.h>

#include "Foundation/Strings.h"

namespace plume {
namespace {

RunningApplication program(const std::u16string& name) {
    return {.processIdentifier = 42,
            .bundleIdentifier = u"org.example.keys",
            .localizedName = name,
            .executableURL = u"/usr/bin/keys"};
}

TEST(DiagnosticReport, OfAWorkingPlumeNamesVersionsAndTheForegroundProgram) {
    const DiagnosticFindings findings{.version = u"0.1.0",
                                      .systemVersion = u"Debian GNU/Linux 12",
                                      .isEnabled = true,
                                      .hasEventTap = true,
                                      .foregroundProgram = program(u"\u7F16\u8F91 \U0001F600")};
    EXPECT_EQ(toUtf8(diagnosticReport(findings)),
              "Plume version: 0.1.0\n"
              "System version: Debian GNU/Linux 12\n\n"
              "Plume is enabled.\n"
              "\n"
              "Foreground program: \u7F16\u8F91 \U0001F600\n\n"
              "\n");
}

TEST(DiagnosticReport, SaysWhatStandsInTheWay) {
    DiagnosticFindings findings{.version = u"1", .systemVersion = u"2"};
    findings.secureInputIsOn = true;
    findings.secureInputApplication = u"Safe";
    findings.otherEventTaps = {program(u"Keys"), RunningApplication{7, {}, {}, {}}};
    EXPECT_EQ(toUtf8(diagnosticReport(findings)),
              "Plume version: 1\n"
              "System version: 2\n\n"
              "Plume is disabled.\n"
              "Click Plume icon on menu bar and select \"Enabled\".\n"
              "\n"
              "Plume is not working. Plume can not create event tap. Try restart your computer.\n"
              "Foreground program: \n\n"
              "Secure Input is enabled (by Safe).\n"
              "Try quit this app to release Secure Input.\n"
              "If it is unidentified, try quit your running apps."
              "\n"
              "Processes created event tap and may conflict with Plume:\n"
              "\t PID: 42, Name: Keys, Identifier: org.example.keys, URL: /usr/bin/keys\n"
              "\t PID: 7, Name: , Identifier: , URL: \n"
              "Try quit these processes.\n");
}

TEST(SecureInputStatus, NamesAnApplicationThatIsKnownAndNotPlume) {
    EXPECT_EQ(secureInputStatus(false, u"Safe"), u"Secure Input is not enabled");
    EXPECT_EQ(secureInputStatus(true, u"Safe"), u"Secure Input is enabled (by Safe)");
    for (const auto& unknown : {std::optional<std::u16string>(), std::optional<std::u16string>(u"Plume")}) {
        EXPECT_EQ(secureInputStatus(true, unknown), u"Secure Input is enabled (by unidentified application)");
    }
}

}  // namespace
}  // namespace plume
