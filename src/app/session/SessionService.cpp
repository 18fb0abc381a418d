#include "app/session/SessionService.h"

#include <QDBusAbstractAdaptor>
#include <QDBusConnection>
#include <QStringList>
#include <QUrl>
#include <QVariantMap>
#include <utility>

namespace plume {

namespace {

constexpr const char* Name = "org.plume.Plume";
constexpr const char* Path = "/org/plume/Plume";

std::vector<std::string> wordsOf(const char* command, const QStringList& files) {
    std::vector<std::string> words{command};
    for (const QString& file : files) {
        const QUrl url(file);
        words.push_back((url.isLocalFile() ? url.toLocalFile() : file).toStdString());
    }
    return words;
}

// What went wrong is the caller's to hear, what was said is the answer.
QString answerOf(const CommandReply& reply) {
    return QString::fromStdString(reply.status == 0 ? reply.output : reply.error).trimmed();
}

}  // namespace

// What a launcher calls: to start, to open files, and for the actions of the desktop file.
class LauncherAdaptor final : public QDBusAbstractAdaptor {
    Q_OBJECT
    Q_CLASSINFO("D-Bus Interface", "org.freedesktop.Application")
  public:
    explicit LauncherAdaptor(SessionService& service) : QDBusAbstractAdaptor(&service), service_(service) {}

  public Q_SLOTS:
    void Activate(const QVariantMap& /*platformData*/) { service_.perform({"show"}); }
    void Open(const QStringList& uris, const QVariantMap& /*platformData*/) { service_.perform(wordsOf("open", uris)); }
    // Those of the desktop file: "toggle", or a window to show.
    void ActivateAction(const QString& name, const QVariantList& /*parameters*/, const QVariantMap& /*platformData*/) {
        const std::string action = name.toStdString();
        service_.perform(action == "toggle" ? std::vector<std::string>{action}
                                            : std::vector<std::string>{"show", action});
    }

  private:
    SessionService& service_;
};

// What scripts and the shortcuts of desktops call.
class PlumeAdaptor final : public QDBusAbstractAdaptor {
    Q_OBJECT
    Q_CLASSINFO("D-Bus Interface", "org.plume.Plume")
  public:
    explicit PlumeAdaptor(SessionService& service) : QDBusAbstractAdaptor(&service), service_(service) {}

  public Q_SLOTS:
    void Toggle() { service_.perform({"toggle"}); }
    void Show() { service_.perform({"show"}); }
    void QuickSearch() { service_.perform({"quick-search"}); }
    void Suggest() { service_.perform({"suggest"}); }
    void Undo() { service_.perform({"undo"}); }
    void Expand() { service_.perform({"expand-typed"}); }
    QString Import(const QStringList& files) { return answerOf(service_.perform(wordsOf("import", files))); }
    QString Export(const QString& file) { return answerOf(service_.perform(wordsOf("export", {file}))); }
    QString State() { return answerOf(service_.perform({"status", "--json"})); }
    QString Version() { return answerOf(service_.perform({"--version"})); }

  private:
    SessionService& service_;
};

SessionService::SessionService(Perform perform) : perform_(std::move(perform)) {
    new LauncherAdaptor(*this);
    new PlumeAdaptor(*this);
    QDBusConnection bus = QDBusConnection::sessionBus();
    if (!bus.isConnected()) return;
    registered_ = bus.registerObject(Path, this) && bus.registerService(Name);
}

SessionService::~SessionService() {
    QDBusConnection bus = QDBusConnection::sessionBus();
    if (registered_) bus.unregisterService(Name);
    if (bus.isConnected()) bus.unregisterObject(Path);
}

}  // namespace plume

#include "SessionService.moc"
