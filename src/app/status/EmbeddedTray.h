// Whether the X display has a tray of the old kind, into which programs put windows of their own.
//
// Told by the server, never asked for again. Belongs to the main thread; on other platforms there is none.
#pragma once

#include <QAbstractNativeEventFilter>
#include <QObject>
#include <cstdint>

struct xcb_connection_t;

namespace plume {

class EmbeddedTray final : public QObject, private QAbstractNativeEventFilter {
    Q_OBJECT
  public:
    explicit EmbeddedTray(QObject* parent);
    ~EmbeddedTray() override;

    // The tray's window; 0: there is none.
    std::uint32_t window() const { return window_; }

  Q_SIGNALS:
    // It came, went or is another one now.
    void changed();

  private:
    bool nativeEventFilter(const QByteArray& type, void* message, qintptr* result) override;
    std::uint32_t atom(const QByteArray& name) const;
    void lookAgain();

    xcb_connection_t* connection_ = nullptr;
    std::uint32_t selection_ = 0;
    std::uint32_t manager_ = 0;
    std::uint32_t window_ = 0;
};

}  // namespace plume
