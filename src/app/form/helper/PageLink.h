// What a form's page and this program call of each other, over a web channel.
//
// On the main thread; belongs to the form's window. What is told to a page that does not listen yet waits for it.
#pragma once

#include <QJsonObject>
#include <QObject>
#include <QSize>
#include <QString>
#include <functional>
#include <vector>

namespace plume {

class PageLink final : public QObject {
    Q_OBJECT
  public:
    struct Events {
        std::function<void(QSize size)> measured;  // as large as the page would be
        std::function<void()> drawn;               // what stands there since appear()
        std::function<void(int field, const QString& value, int choice, bool isUnreadable)> filled;
        std::function<void(int field, bool selected)> selected;
        std::function<void()> accepted;
        std::function<void()> cancelled;
        std::function<void()> stayed;
    };

    explicit PageLink(Events events) : events_(std::move(events)) {}

    void update(const QJsonObject& changes);
    void appear();
    void setColours(const QString& style) { Q_EMIT coloured(style); }

    // For the page.
    Q_SIGNAL void updated(const QJsonObject& changes);
    Q_SIGNAL void appears();
    Q_SIGNAL void coloured(const QString& style);
    Q_INVOKABLE void linked();
    Q_INVOKABLE void measured(int width, int height) const { events_.measured({width, height}); }
    Q_INVOKABLE void drawn() const { events_.drawn(); }
    Q_INVOKABLE void filled(int field, const QString& value, int choice, bool isUnreadable) const;
    Q_INVOKABLE void selected(int field, bool selected) const { events_.selected(field, selected); }
    Q_INVOKABLE void accepted() const { events_.accepted(); }
    Q_INVOKABLE void cancelled() const { events_.cancelled(); }
    Q_INVOKABLE void stayed() const { events_.stayed(); }

  private:
    const Events events_;
    bool isLinked_ = false;
    std::vector<QJsonObject> waiting_;
};

}  // namespace plume
