// The pages of the settings window, each made when it is first seen or searched.
//
// Main thread; the caller owns the page.
#pragma once

#include "app/preferences/PreferencesPage.h"

namespace plume {

PreferencesPage* makeGeneralPage(const PreferencesPage::Around& around);
PreferencesPage* makeExpansionPage(const PreferencesPage::Around& around);
PreferencesPage* makeSearchPage(const PreferencesPage::Around& around);
PreferencesPage* makeTypingPage(const PreferencesPage::Around& around);
PreferencesPage* makeCorrectionPage(const PreferencesPage::Around& around);
PreferencesPage* makeHotKeysPage(const PreferencesPage::Around& around);
PreferencesPage* makeApplicationsPage(const PreferencesPage::Around& around);
PreferencesPage* makeBackupsPage(const PreferencesPage::Around& around);
PreferencesPage* makeImportExportPage(const PreferencesPage::Around& around);
PreferencesPage* makeAdvancedPage(const PreferencesPage::Around& around);

}  // namespace plume
