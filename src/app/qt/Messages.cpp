#include "app/qt/Messages.h"

#include <QCoreApplication>
#include <QGuiApplication>
#include <QIcon>
#include <QLabel>
#include <QMessageBox>
#include <QPushButton>

namespace plume {

namespace {

constexpr int IconSize = 48;

class Texts {
    Q_DECLARE_TR_FUNCTIONS(plume::Messages)
};

}  // namespace

QMessageBox* makeMessageBox(QWidget* parent, const QString& message, const QString& details) {
    auto* box = new QMessageBox(parent);
    box->setAttribute(Qt::WA_DeleteOnClose);
    box->setWindowTitle(QStringLiteral("Plume"));
    box->setText(message);
    box->setInformativeText(details);
    // Also the second text, which the box's own text format leaves out: errors hold names of files.
    for (QLabel* label : box->findChildren<QLabel*>()) label->setTextFormat(Qt::PlainText);
    auto* heading = box->findChild<QLabel*>(QStringLiteral("qt_msgbox_label"));
    // Plume's own icon, which the style has no better one for; a box without any leaves its place empty.
    box->setIconPixmap(QGuiApplication::windowIcon().pixmap(IconSize));
    QFont font = heading->font();
    font.setBold(true);
    heading->setFont(font);
    // Nothing else of the program is held up by a message without a window.
    if (!parent) box->setWindowModality(Qt::NonModal);
    return box;
}

QWidget* tell(QWidget* parent, const QString& message, const QString& details) {
    QMessageBox* box = makeMessageBox(parent, message, details);
    box->addButton(QMessageBox::Ok)->setText(Texts::tr("OK"));
    parent ? box->open() : box->show();
    return box;
}

void ask(QWidget* parent, const QString& message, const QString& details, const QString& consent,
         std::function<void()> agreed) {
    QMessageBox* box = makeMessageBox(parent, message, details);
    const auto* yes = box->addButton(consent, QMessageBox::AcceptRole);
    QPushButton* no = box->addButton(Texts::tr("Cancel"), QMessageBox::RejectRole);
    box->setDefaultButton(no);
    box->setEscapeButton(no);
    QObject::connect(box, &QMessageBox::finished, parent ? parent : box, [box, yes, agreed = std::move(agreed)] {
        if (box->clickedButton() == yes) agreed();
    });
    box->open();
}

}  // namespace plume
