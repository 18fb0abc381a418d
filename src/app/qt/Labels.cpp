#include "app/qt/Labels.h"

#include <QLabel>

namespace plume {

namespace {

constexpr double HeadingScale = 1.35;

QLabel* makeBoldLabel(const QString& text, double scale) {
    QLabel* label = makeTextLabel(text);
    QFont font = label->font();
    font.setPointSizeF(font.pointSizeF() * scale);
    font.setBold(true);
    label->setFont(font);
    return label;
}

}  // namespace

QLabel* makeTextLabel(const QString& text) {
    auto* label = new QLabel(text);
    label->setTextFormat(Qt::PlainText);
    label->setWordWrap(true);
    label->setMinimumWidth(1);
    return label;
}

QLabel* makeHelpLabel(const QString& text) {
    QLabel* label = makeTextLabel(text);
    label->setForegroundRole(QPalette::PlaceholderText);
    return label;
}

QLabel* makeHeading(const QString& text) {
    return makeBoldLabel(text, HeadingScale);
}

QLabel* makeSectionTitle(const QString& text) {
    return makeBoldLabel(text, 1);
}

QString breakable(QString path) {
    return path.replace(QLatin1Char('/'), QStringLiteral("/\u200B"));
}

}  // namespace plume
