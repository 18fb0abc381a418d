// A Qt 6 text edit that tells a test what happens in it. Argument: the test's socket.

#include <QApplication>
#include <QFocusEvent>
#include <QLineEdit>
#include <QMimeData>
#include <QSocketNotifier>
#include <QTextCursor>
#include <QTextDocument>
#include <QTextEdit>
#include <algorithm>
#include <memory>

#include "testing/rig/targets/TargetChannel.h"

namespace {

using plume::target::TargetChannel;

class TargetEdit : public QTextEdit {
  public:
    explicit TargetEdit(const char* socketPath)
        : channel_(socketPath, {[this] { return toPlainText().toStdString(); },
                                [this](const std::string& text) { setPlainText(QString::fromStdString(text)); },
                                [this](bool shown) { showPassword(shown); }}) {
        connect(document(), &QTextDocument::contentsChange, this, &TargetEdit::reportChange);
    }

    TargetChannel& channel() { return channel_; }

  protected:
    void insertFromMimeData(const QMimeData* source) override {
        QTextEdit::insertFromMimeData(source);
        channel_.reportPasted(length());
    }

    void showEvent(QShowEvent* event) override {
        QTextEdit::showEvent(event);
        channel_.reportReady(static_cast<unsigned long>(winId()));
    }

  private:
    int length() { return plume::target::countCharacters(toPlainText().toStdString()); }

    void showPassword(bool shown) {
        password_.reset();
        if (!shown) return;
        password_ = std::make_unique<QLineEdit>();
        password_->setEchoMode(QLineEdit::Password);
        password_->setText("secret");
        password_->setFocus();
        password_->show();
        password_->activateWindow();
    }

    // The document counts the end of its last paragraph, too: some changes are told one longer than they are.
    void reportChange(int position, int removed, int added) {
        const int last = document()->characterCount() - 1;
        QTextCursor cursor(document());
        cursor.setPosition(std::min(position, last));
        cursor.setPosition(std::min(position + added, last), QTextCursor::KeepAnchor);
        const QString inserted = cursor.selectedText().replace(QChar::ParagraphSeparator, QLatin1Char('\n'));
        channel_.reportText(position, removed, inserted.toStdString(), length());
    }

    TargetChannel channel_;
    std::unique_ptr<QLineEdit> password_;
};

}  // namespace

int main(int argc, char** argv) {
    QApplication application(argc, argv);
    if (argc < 2) return 2;
    TargetEdit edit(argv[1]);
    QSocketNotifier requests(edit.channel().descriptor(), QSocketNotifier::Read);
    QObject::connect(&requests, &QSocketNotifier::activated, &application, [&] {
        if (!edit.channel().answerRequests()) QApplication::quit();
    });
    edit.setAcceptRichText(true);
    edit.setWindowTitle("Qt text");
    edit.setAccessibleName("Qt text");
    edit.resize(480, 320);
    edit.show();
    return QApplication::exec();
}
