// Draws the files within a text: pictures as they are, all others as an icon with their name.
//
// On the main thread. Its owner registers it with the document's layout, for InlineObject::File, and outlives that.
#pragma once

#include <QHash>
#include <QImage>
#include <QObject>
#include <QTextObjectInterface>
#include <memory>

#include "Foundation/text/TextAttributes.h"

namespace plume {

class FileObject final : public QObject, public QTextObjectInterface {
    Q_OBJECT
    Q_INTERFACES(QTextObjectInterface)
  public:
    QSizeF intrinsicSize(QTextDocument* document, int position, const QTextFormat& format) override;
    void drawObject(QPainter* painter, const QRectF& rect, QTextDocument* document, int position,
                    const QTextFormat& format) override;

    void forgetPictures() { pictures_.clear(); }

  private:
    struct Picture {
        std::shared_ptr<const TextAttachment> file;  // holds the key's object
        QImage image;                                // null: it is none that can be shown
    };
    const QImage& pictureOf(const std::shared_ptr<const TextAttachment>& file);

    QHash<const TextAttachment*, Picture> pictures_;
};

}  // namespace plume
