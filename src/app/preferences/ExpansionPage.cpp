#include <QCoreApplication>

#include "app/preferences/PreferencesPages.h"

namespace plume {

namespace {

class ExpansionPage final : public PreferencesPage {
    Q_DECLARE_TR_FUNCTIONS(ExpansionPage)
  public:
    explicit ExpansionPage(const Around& around) : PreferencesPage(around) {
        addHeading(tr("Capitals"));
        // The only bit of the option that has a meaning.
        addBit("SnippetAdaptToAbbreviationCaseOption", 1, tr("Mixed &case gives every word a capital"),
               tr("Where a text adapts to how its abbreviation is typed: “bRb” gives every word a capital. Without "
                  "this only one that ends with a capital does, like “bRB”."));
        addHeading(tr("Typing"));
        addCheckBox("ListenMouseDownEvents", tr("A mouse click &ends the abbreviation"),
                    tr("What was typed before a click and what is typed after it are then never one abbreviation."));
        addHeading(tr("Forms"));
        addCheckBox("PlainForms", tr("&Fill in fields in a plain window"),
                    tr("Instead of a page that looks like the text. The program that draws pages needs some 200 MB "
                       "while forms are in use, and goes ten minutes after the last one."));
        addHeading(tr("Passwords"));
        addCheckBox("LetProgramsTellPasswordFields", tr("Let programs tell which fields are for &passwords"),
                    tr("Plume is deaf in these fields. Browsers and some other programs tell it only while the "
                       "desktop’s accessibility is on, which this switches on when Plume starts. It costs these "
                       "programs some time and memory."));
    }
};

}  // namespace

PreferencesPage* makeExpansionPage(const PreferencesPage::Around& around) {
    return new ExpansionPage(around);
}

}  // namespace plume
