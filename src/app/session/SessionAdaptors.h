// What others call on the session bus, method by method. Each belongs to the service that it hands its calls to.
#pragma once

#include <QDBusAbstractAdaptor>
#include <QStringList>
#include <QVariantMap>

#include "app/session/SessionService.h"

namespace plume {

// The names of the methods are those on the bus.
// NOLINTBEGIN(readability-identifier-naming)

// What a launcher calls: to start, to open files, and for the actions of the desktop file.
class LauncherAdaptor final : public QDBusAbstractAdaptor {
    Q_OBJECT
    Q_CLASSINFO("D-Bus Interface", "org.freedesktop.Application")
  public:
    explicit LauncherAdaptor(SessionService& service) : QDBusAbstractAdaptor(&service), service_(service) {}

    Q_SLOT void Activate(const QVariantMap& platformData);
    Q_SLOT void Open(const QStringList& uris, const QVariantMap& platformData);
    // Those of the desktop file: "toggle", "quick-search", or a window to show.
    Q_SLOT void ActivateAction(const QString& name, const QVariantList& parameters, const QVariantMap& platformData);

  private:
    SessionService& service_;
};

// What scripts and the shortcuts of desktops call. What goes wrong with a file is the answer.
class PlumeAdaptor final : public QDBusAbstractAdaptor {
    Q_OBJECT
    Q_CLASSINFO("D-Bus Interface", "org.plume.Plume")
  public:
    explicit PlumeAdaptor(SessionService& service) : QDBusAbstractAdaptor(&service), service_(service) {}

    Q_SLOT void Toggle() { service_.perform({"toggle"}); }
    Q_SLOT void Show() { service_.perform({"show"}); }
    Q_SLOT void QuickSearch() { service_.perform({"quick-search"}); }
    Q_SLOT void Suggest() { service_.perform({"suggest"}); }
    Q_SLOT void Undo() { service_.perform({"undo"}); }
    Q_SLOT void Expand() { service_.perform({"expand-typed"}); }
    Q_SLOT QString Import(const QStringList& files);
    Q_SLOT QString Export(const QString& file);
    Q_SLOT QString State();
    Q_SLOT QString Version();

  private:
    SessionService& service_;
};

// NOLINTEND(readability-identifier-naming)

}  // namespace plume
