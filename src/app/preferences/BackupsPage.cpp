#include <QCheckBox>
#include <QComboBox>
#include <QCoreApplication>
#include <QDateTime>
#include <QHBoxLayout>
#include <QLabel>
#include <QLocale>
#include <QPushButton>
#include <QSignalBlocker>
#include <QSpinBox>
#include <algorithm>
#include <chrono>

#include "app/preferences/FolderChoice.h"
#include "app/preferences/PreferencesPages.h"
#include "app/preferences/SettingControls.h"
#include "app/qt/Sentences.h"
#include "app/qt/Text.h"
#include "app/qt/WheelGuard.h"

namespace plume {

namespace {

constexpr const char* Interval = "AutoBackupInterval";
constexpr const char* Directory = "BackupDirectory";
constexpr const char* Quantity = "BackupQuantity";
constexpr const char* SyncEnabled = "SyncEnabled";
constexpr const char* SyncDirectory = "SyncDirectory";
constexpr const char* SyncDirectoryType = "SyncDirectoryType";
constexpr const char* SyncPreferences = "SyncPreferences";
constexpr int MostBackups = 9999;

QString shown(const Date& date) {
    const auto moment = std::chrono::duration_cast<std::chrono::milliseconds>(date.time_since_epoch()).count();
    return QLocale().toString(QDateTime::fromMSecsSinceEpoch(moment), QLocale::ShortFormat);
}

class BackupsPage final : public PreferencesPage {
    Q_DECLARE_TR_FUNCTIONS(BackupsPage)
  public:
    explicit BackupsPage(const Around& around) : PreferencesPage(around) {
        addBackups();
        addSync();
    }

    void restoreDefaults() override {
        PreferencesPage::restoreDefaults();
        services().syncSettingsChanged();
    }

    void showEvent(QShowEvent* event) override {
        countBackups();
        PreferencesPage::showEvent(event);
    }

  private:
    void addBackups() {
        addHeading(tr("Backups"));
        addInterval();
        auto* folder = new FolderChoice(FolderChoice::Offers::DefaultToo);
        folder->setName(tr("Folder of backups"));
        addField(tr("F&older:"), folder, {}, {QLatin1String(Directory)});
        bind(Directory, [this, folder] {
            const Keys own = settings().ownKeys();
            const bool isOwn = std::find(own.begin(), own.end(), Directory) != own.end();
            folder->setFolder(settings().stringForKey(Directory).value_or(u""), !isOwn);
            if (backupCount_) countBackups();
        });
        connect(folder, &FolderChoice::chosen, this, [this](const std::u16string& path) { write(Directory, path); });
        connect(folder, &FolderChoice::defaultChosen, this, [this] { giveUp(Directory); });
        const auto unit = [](int count) { return count == 1 ? tr(" backup") : tr(" backups", "", count); };
        addNumber(Quantity, tr("&Keep:"), {0, MostBackups, unit}, tr("The oldest go when there are more."))
            ->setSpecialValueText(tr("All backups"));
        addButtons();
        backupCount_ = addNote({});
    }

    // Every other value means never.
    void addInterval() {
        auto* box = new QComboBox;
        ignoreWheelWithoutFocus(*box);
        box->addItems({tr("Never"), tr("Every hour"), tr("Every day"), tr("Every week"), tr("Every 30 days")});
        addField(tr("Back &up:"), box, {}, {QLatin1String(Interval)});
        bind(Interval, [this, box] {
            const QSignalBlocker quiet(box);
            const std::int64_t value = settings().integerForKey(Interval);
            box->setCurrentIndex(value > 0 && value < box->count() ? int(value) : 0);
        });
        connect(box, &QComboBox::currentIndexChanged, this,
                [this](int index) { write(Interval, std::int64_t{index}); });
    }

    void addButtons() {
        auto* row = new QWidget;
        auto* now = new QPushButton(tr("&Back Up Now"));
        auto* restore = new QPushButton(tr("&Restore…"));
        auto* layout = new QHBoxLayout(row);
        layout->setContentsMargins(0, 0, 0, 0);
        layout->addWidget(now);
        layout->addWidget(restore);
        row->setFocusProxy(now);
        addWide(tr("Back Up Now, Restore"), row);
        connect(now, &QPushButton::clicked, this, &BackupsPage::backUp);
        connect(restore, &QPushButton::clicked, this, [this] { services().restore(); });
    }

    void backUp() {
        const auto written = services().dataManager.backups().backup();
        countBackups();
        if (!written) return complain(tr("No backup was made. %1").arg(inUsersLanguage(written.error().message)));
        complain({});
        const QString name = QString::fromStdString(written.value().filename().string());
        backupCount_->setText(tr("Written: %1").arg(name) + u'\n' + backupCount_->text());
    }

    void countBackups() {
        const auto backups = services().dataManager.backups().backups();
        if (backups.empty()) return backupCount_->setText(tr("There is no backup in this folder yet."));
        std::optional<Date> newest;
        for (const auto& backup : backups) newest = std::max(newest, backup.modified);
        const QString count =
            backups.size() == 1 ? tr("There is 1 backup.") : tr("There are %n backups.", "", int(backups.size()));
        backupCount_->setText(newest ? count + u' ' + tr("The newest was made %1.").arg(shown(*newest)) : count);
    }

    void addSync() {
        addHeading(tr("Sync"));
        auto* enabled = addCheckBox(SyncEnabled, tr("Keep the library in &step with other computers"),
                                    tr("By a file in a folder that these computers share."));
        auto* folder = new FolderChoice(FolderChoice::Offers::FoldersOnly);
        folder->setName(tr("Shared folder"));
        addField(tr("Shared &folder:"), folder, {}, {QLatin1String(SyncDirectory)});
        bind(SyncDirectory,
             [this, folder] { folder->setFolder(settings().stringForKey(SyncDirectory).value_or(u"")); });
        auto* preferences = addCheckBox(SyncPreferences, tr("Some settings &go along"),
                                        tr("Those of the pages Typing and clipboard, and Correction."));
        syncState_ = addNote({});
        for (const char* key : {SyncEnabled, SyncDirectory, SyncDirectoryType}) bind(key, [this] { showSyncState(); });
        for (const QCheckBox* box : {enabled, preferences}) {
            connect(box, &QCheckBox::toggled, this, [this] { services().syncSettingsChanged(); });
        }
        connect(folder, &FolderChoice::chosen, this, &BackupsPage::syncWith);
    }

    void syncWith(const std::u16string& path) {
        // Other types lead to no folder here.
        if (settings().integerForKey(SyncDirectoryType) != 0 && !giveUp(SyncDirectoryType)) return;
        if (write(SyncDirectory, path)) services().syncSettingsChanged();
    }

    void showSyncState() {
        const bool waits = settings().boolForKey(SyncEnabled) && !services().dataManager.sync().syncDirectory();
        syncState_->setText(waits ? tr("Nothing is kept in step yet: choose a folder that exists.") : QString());
        syncState_->setVisible(waits);
    }

    QLabel* backupCount_ = nullptr;
    QLabel* syncState_ = nullptr;
};

}  // namespace

PreferencesPage* makeBackupsPage(const PreferencesPage::Around& around) {
    return new BackupsPage(around);
}

}  // namespace plume
