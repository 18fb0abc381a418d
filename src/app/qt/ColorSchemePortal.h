// Whether the desktop is dark, by its portal on the session bus.
//
// Belongs to the main thread. A desktop without a portal tells nothing.
#pragma once

#include <QDBusVariant>
#include <QObject>
#include <QString>
#include <functional>

namespace plume {

class ColorSchemePortal final : public QObject {
    Q_OBJECT
  public:
    using Told = std::function<void(bool isDark)>;

    // How it is now, and every change from now on, is told later.
    explicit ColorSchemePortal(Told told);

  private:
    Q_SLOT void changed(const QString& group, const QString& key, const QDBusVariant& value);
    void tell(QVariant value) const;

    const Told told_;
};

}  // namespace plume
