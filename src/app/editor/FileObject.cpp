#include "app/editor/FileObject.h"

#include <QApplication>
#include <QBuffer>
#include <QFontMetricsF>
#include <QImageReader>
#include <QPainter>
#include <QStyle>
#include <QTextDocument>
#include <algorithm>

#include "app/editor/TextFormats.h"
#include "app/qt/Text.h"

namespace plume {

namespace {

std::shared_ptr<const TextAttachment> fileIn(const QTextFormat& format) {
    const SharedAttributes attributes = attributesIn(format);
    return attributes ? attributes->attachment : nullptr;
}

QFontMetricsF metricsOf(const QTextDocument& document) {
    return QFontMetricsF(document.defaultFont());
}

double widestName(const QFontMetricsF& metrics) {
    constexpr int Letters = 30;
    return Letters * metrics.averageCharWidth();
}

QString nameOf(const std::shared_ptr<const TextAttachment>& file) {
    return file ? toQString(file->fileName) : QString();
}

// In the text's units: pictures of dense screens say how many of their dots make an inch, but programs that write
// them rarely mean it.
QSizeF shownSize(const QImage& image, const QTextDocument& document) {
    QSizeF size = image.size();
    const double room = document.textWidth() - 2 * document.documentMargin();
    if (room > 0 && size.width() > room) size.scale(room, size.height(), Qt::KeepAspectRatio);
    return size;
}

}  // namespace

const QImage& FileObject::pictureOf(const std::shared_ptr<const TextAttachment>& file) {
    static const QImage none;
    if (!file) return none;
    const auto found = pictures_.constFind(file.get());
    if (found != pictures_.constEnd()) return found->image;
    QByteArray bytes = QByteArray::fromRawData(file->contents.data(), static_cast<qsizetype>(file->contents.size()));
    QBuffer buffer(&bytes);
    QImageReader reader(&buffer);
    reader.setDecideFormatFromContent(true);
    return pictures_.insert(file.get(), {file, reader.canRead() ? reader.read() : QImage()})->image;
}

QSizeF FileObject::intrinsicSize(QTextDocument* document, int /*position*/, const QTextFormat& format) {
    const auto file = fileIn(format);
    const QImage& image = pictureOf(file);
    if (!image.isNull()) return shownSize(image, *document);
    const QFontMetricsF metrics = metricsOf(*document);
    const double name = std::min(metrics.horizontalAdvance(nameOf(file)), widestName(metrics));
    return {metrics.height() * 1.5 + name, metrics.height()};
}

void FileObject::drawObject(QPainter* painter, const QRectF& rect, QTextDocument* document, int /*position*/,
                            const QTextFormat& format) {
    const auto file = fileIn(format);
    painter->save();
    if (const QImage& image = pictureOf(file); !image.isNull()) {
        painter->setRenderHint(QPainter::SmoothPixmapTransform);
        painter->drawImage(rect, image);
    } else {
        const QFontMetricsF metrics = metricsOf(*document);
        const QRectF icon(rect.topLeft(), QSizeF(rect.height(), rect.height()));
        QApplication::style()->standardIcon(QStyle::SP_FileIcon).paint(painter, icon.toAlignedRect());
        painter->setFont(document->defaultFont());
        painter->setPen(QApplication::palette().color(QPalette::Text));
        const QString name = metrics.elidedText(nameOf(file), Qt::ElideMiddle, widestName(metrics));
        painter->drawText(QPointF(icon.right() + rect.height() / 4, rect.bottom() - metrics.descent()), name);
    }
    painter->restore();
}

}  // namespace plume
