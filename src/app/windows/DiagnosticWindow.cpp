#include "app/windows/DiagnosticWindow.h"

#include <QClipboard>
#include <QFileDialog>
#include <QFontDatabase>
#include <QGuiApplication>
#include <QHBoxLayout>
#include <QLabel>
#include <QPlainTextEdit>
#include <QPushButton>
#include <QSaveFile>
#include <QScreen>
#include <QVBoxLayout>

#include "app/qt/Labels.h"
#include "app/qt/Messages.h"

namespace plume {

DiagnosticWindow::DiagnosticWindow(const QString& report)
    : SmallWindow(tr("Plume Diagnostics")), text_(new QPlainTextEdit), done_(makeTextLabel()) {
    setObjectName(QStringLiteral("DiagnosticWindow"));
    text_->setReadOnly(true);
    text_->setTextInteractionFlags(Qt::TextSelectableByMouse | Qt::TextSelectableByKeyboard);
    text_->setTabChangesFocus(true);
    text_->setFont(QFontDatabase::systemFont(QFontDatabase::FixedFont));
    text_->setAccessibleName(tr("Report"));
    auto* copyButton = new QPushButton(tr("&Copy"));
    auto* saveButton = new QPushButton(tr("&Save…"));
    connect(copyButton, &QPushButton::clicked, this, &DiagnosticWindow::copy);
    connect(saveButton, &QPushButton::clicked, this, &DiagnosticWindow::chooseFile);
    copyButton->setDefault(true);
    auto* buttons = new QHBoxLayout;
    buttons->addWidget(done_, 1);
    buttons->addWidget(copyButton);
    buttons->addWidget(saveButton);
    auto* layout = new QVBoxLayout(this);
    layout->addWidget(makeTextLabel(
        tr("This report says how Plume is doing. It holds none of your snippets and nothing that you typed.")));
    layout->addWidget(text_, 1);
    layout->addLayout(buttons);
    setReport(report);
    const int em = fontMetrics().height();
    resize(38 * em, 24 * em);
}

void DiagnosticWindow::setReport(const QString& report) {
    text_->setPlainText(report);
    done_->clear();
}

void DiagnosticWindow::showCentred() {
    bringToFront(*this);
    QRect place = frameGeometry();
    place.moveCenter(screen()->availableGeometry().center());
    move(place.topLeft());
}

void DiagnosticWindow::copy() {
    QGuiApplication::clipboard()->setText(text_->toPlainText());
    done_->setText(tr("The report is on the clipboard."));
}

void DiagnosticWindow::chooseFile() {
    auto* panel = new QFileDialog(this, tr("Save Report"), {}, tr("Text files (*.txt)"));
    panel->setAttribute(Qt::WA_DeleteOnClose);
    panel->setAcceptMode(QFileDialog::AcceptSave);
    panel->setDefaultSuffix(QStringLiteral("txt"));
    panel->selectFile(tr("Plume Report.txt"));
    connect(panel, &QFileDialog::fileSelected, this, &DiagnosticWindow::saveTo);
    panel->open();
}

void DiagnosticWindow::saveTo(const QString& path) {
    QSaveFile file(path);
    const bool written = file.open(QIODevice::WriteOnly) && file.write(text_->toPlainText().toUtf8()) >= 0;
    if (written && file.commit()) return done_->setText(tr("The report was saved."));
    tell(this, tr("The report was not saved"), path + QStringLiteral(": ") + file.errorString());
}

}  // namespace plume
