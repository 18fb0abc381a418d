#include <QCoreApplication>

#include "app/preferences/PreferencesPages.h"

namespace plume {

namespace {

// Longer ones are not told apart from short ones.
constexpr int LongestLength = 127;
constexpr double Day = 24 * 60 * 60;

class TypingPage final : public PreferencesPage {
    Q_DECLARE_TR_FUNCTIONS(TypingPage)
  public:
    explicit TypingPage(const Around& around) : PreferencesPage(around) {
        addHeading(tr("Pasting"));
        addCheckBox("UseClipboard", tr("&Paste texts instead of typing them"),
                    tr("Pasting is faster; typing leaves the clipboard alone."));
        addAvailability("UseClipboardIn", "UseClipboardApplications", tr("P&aste:"));
        addHeading(tr("Long texts"));
        addCheckBox("UseClipboardForLongText", tr("Paste &long texts everywhere"));
        const auto unit = [](int count) { return count == 1 ? tr(" character") : tr(" characters", "", count); };
        addNumber("LongTextLength", tr("Long &from:"), {1, LongestLength, unit});
        addHeading(tr("What you copied"));
        addCheckBox("RestoreClipboard", tr("&Give back what was copied after a paste"));
        addSeconds("RestoreClipboardDelay", tr("Give it back af&ter:"), Day,
                   tr("Programs that paste slowly need more."));
    }
};

}  // namespace

PreferencesPage* makeTypingPage(const PreferencesPage::Around& around) {
    return new TypingPage(around);
}

}  // namespace plume
