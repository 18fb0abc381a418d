#include "app/qt/WindowPlaces.h"

#include <QEvent>
#include <QWidget>
#include <string>

#include "app/qt/Text.h"

namespace plume {

namespace {

class PlaceKeeper final : public QObject {
  public:
    PlaceKeeper(QWidget& window, WritableUserDefaults& settings, std::string key)
        : QObject(&window), settings_(settings), key_(std::move(key)) {
        window.installEventFilter(this);
        const auto kept = settings_.stringForKey(key_);
        if (kept) window.restoreGeometry(QByteArray::fromBase64(toQString(*kept).toLatin1()));
    }

    bool eventFilter(QObject* object, QEvent* event) override {
        if (event->type() == QEvent::Close) keep(*static_cast<QWidget*>(object));
        return false;
    }

  private:
    void keep(const QWidget& window) {
        std::u16string now = fromQString(QString::fromLatin1(window.saveGeometry().toBase64()));
        // A window that cannot be found again where it was is no reason to say anything.
        if (now != settings_.stringForKey(key_)) static_cast<void>(settings_.setObject(key_, std::move(now)));
    }

    WritableUserDefaults& settings_;
    const std::string key_;
};

}  // namespace

void rememberPlace(QWidget& window, WritableUserDefaults& settings, const char* name) {
    new PlaceKeeper(window, settings, std::string("WindowPlace.") + name);
}

}  // namespace plume
