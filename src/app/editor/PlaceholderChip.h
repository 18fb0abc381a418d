// Draws placeholders as chips in the line of their text.
//
// On the main thread. Its owner registers it with the document's layout, for InlineObject::Chip, and outlives that.
#pragma once

#include <QHash>
#include <QObject>
#include <QString>
#include <QTextObjectInterface>

#include "content/ContentEnvironment.h"

namespace plume {

class PlaceholderChip final : public QObject, public QTextObjectInterface {
    Q_OBJECT
    Q_INTERFACES(QTextObjectInterface)
  public:
    explicit PlaceholderChip(ContentEnvironment environment = {});

    QSizeF intrinsicSize(QTextDocument* document, int position, const QTextFormat& format) override;
    void drawObject(QPainter* painter, const QRectF& rect, QTextDocument* document, int position,
                    const QTextFormat& format) override;

    // What the chip says. Kept, as it is asked for whenever a line is laid out.
    QString wordsOf(const QTextFormat& chip);
    // Dates are told anew.
    void forgetWords() { words_.clear(); }

  private:
    ContentEnvironment environment_;
    QHash<QString, QString> words_;  // by body
};

}  // namespace plume
