// All settings that Plume knows, as rows: what each is called, its value and its default as JSON.
//
// Main thread. Values are changed as `plume settings` changes them; what does not fit is refused with a reason.
#pragma once

#include <QAbstractTableModel>
#include <functional>
#include <string>

#include "platform/UserDefaults.h"

namespace plume {

class SettingsModel final : public QAbstractTableModel {
    Q_OBJECT
  public:
    enum Column { Name, Value, Default, ColumnCount };

    // The settings outlive it.
    explicit SettingsModel(WritableUserDefaults& settings, QObject* parent = nullptr);

    int rowCount(const QModelIndex& parent = {}) const override;
    int columnCount(const QModelIndex& parent = {}) const override;
    QVariant data(const QModelIndex& index, int role = Qt::DisplayRole) const override;
    QVariant headerData(int section, Qt::Orientation orientation, int role) const override;
    Qt::ItemFlags flags(const QModelIndex& index) const override;
    bool setData(const QModelIndex& index, const QVariant& value, int role = Qt::EditRole) override;

    bool isOwn(int row) const;
    void restoreDefault(int row);
    // The settings have changed.
    void follow();

  Q_SIGNALS:
    // Why the setting was not changed; an empty text: it was.
    void told(const QString& key, const QString& reason);

  private:
    QString valueText(int row) const;

    WritableUserDefaults& settings_;
};

}  // namespace plume
