#include <QCoreApplication>
#include <QPushButton>

#include "app/preferences/PreferencesPages.h"

namespace plume {

namespace {

class ImportExportPage final : public PreferencesPage {
    Q_DECLARE_TR_FUNCTIONS(ImportExportPage)
  public:
    explicit ImportExportPage(const Around& around) : PreferencesPage(around) {
        addHeading(tr("Import"));
        add(tr("&Import a File…"), tr("Snippets of Plume or of another program are added to yours."),
            services().importFile);
        addHeading(tr("Export"));
        add(tr("&Export the Library…"), tr("All snippets go into one file, for another computer or another program."),
            services().exportLibrary);
    }

  private:
    void add(const QString& label, const QString& help, const std::function<void()>& command) {
        auto* button = new QPushButton(label);
        addWide(label, button, help);
        connect(button, &QPushButton::clicked, this, [command] { command(); });
    }
};

}  // namespace

PreferencesPage* makeImportExportPage(const PreferencesPage::Around& around) {
    return new ImportExportPage(around);
}

}  // namespace plume
