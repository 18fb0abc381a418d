#include "app/preferences/SettingsModel.h"

#include <QFont>
#include <algorithm>

#include "app/qt/Sentences.h"
#include "app/qt/Text.h"
#include "library/KnownSettings.h"
#include "library/SettingValues.h"

namespace plume {

namespace {

// Longer ones are for looking at elsewhere.
constexpr int LongestTip = 1000;

const KnownSetting& settingAt(int row) {
    return knownSettings()[static_cast<std::size_t>(row)];
}

QString asText(const std::optional<PropertyList>& value) {
    return value ? QString::fromStdString(settingAsJson(*value).dump()) : QString();
}

}  // namespace

SettingsModel::SettingsModel(WritableUserDefaults& settings, QObject* parent)
    : QAbstractTableModel(parent), settings_(settings) {}

int SettingsModel::rowCount(const QModelIndex& parent) const {
    return parent.isValid() ? 0 : int(knownSettings().size());
}

int SettingsModel::columnCount(const QModelIndex& parent) const {
    return parent.isValid() ? 0 : ColumnCount;
}

QVariant SettingsModel::data(const QModelIndex& index, int role) const {
    if (role == Qt::FontRole && index.column() == Value && isOwn(index.row())) {
        QFont bold;
        bold.setBold(true);
        return bold;
    }
    if (role != Qt::DisplayRole && role != Qt::EditRole && role != Qt::ToolTipRole) return {};
    const KnownSetting& setting = settingAt(index.row());
    if (index.column() == Name) return QString::fromUtf8(setting.name.data(), qsizetype(setting.name.size()));
    // Some defaults are made at the start, such as folders; what holds without a value of one's own is the default.
    const bool isMade = !setting.registered && !isOwn(index.row());
    const QString text = index.column() == Value || isMade ? valueText(index.row()) : asText(setting.registered);
    return role == Qt::ToolTipRole ? text.left(LongestTip) : text;
}

QString SettingsModel::valueText(int row) const {
    return asText(settings_.objectForKey(settingAt(row).name));
}

QVariant SettingsModel::headerData(int section, Qt::Orientation orientation, int role) const {
    if (orientation != Qt::Horizontal || role != Qt::DisplayRole) return {};
    switch (section) {
        case Name:
            return tr("Setting");
        case Value:
            return tr("Value");
        default:
            return tr("Default");
    }
}

Qt::ItemFlags SettingsModel::flags(const QModelIndex& index) const {
    const Qt::ItemFlags usual = QAbstractTableModel::flags(index);
    return index.column() == Value ? usual | Qt::ItemIsEditable : usual;
}

bool SettingsModel::setData(const QModelIndex& index, const QVariant& value, int role) {
    if (role != Qt::EditRole || index.column() != Value) return false;
    const QString text = value.toString();
    if (text == valueText(index.row())) return true;
    const KnownSetting& setting = settingAt(index.row());
    auto read = settingFromText(setting, text.toStdString());
    const Result<void> done =
        read ? settings_.setObject(setting.name, std::move(read).value()) : Result<void>(read.error());
    Q_EMIT told(QLatin1String(setting.name.data(), static_cast<qsizetype>(setting.name.size())),
                done ? QString() : inUsersLanguage(done.error().message));
    return done.ok();
}

bool SettingsModel::isOwn(int row) const {
    const auto own = settings_.ownKeys();
    return std::find(own.begin(), own.end(), settingAt(row).name) != own.end();
}

void SettingsModel::restoreDefault(int row) {
    const KnownSetting& setting = settingAt(row);
    const auto removed = settings_.removeObject(setting.name);
    Q_EMIT told(QLatin1String(setting.name.data(), static_cast<qsizetype>(setting.name.size())),
                removed ? QString() : inUsersLanguage(removed.error().message));
}

void SettingsModel::follow() {
    Q_EMIT dataChanged(index(0, 0), index(rowCount() - 1, ColumnCount - 1));
}

}  // namespace plume
