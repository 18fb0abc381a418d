// Runs tests of windows without a display. A complaint of Qt's is a failure of the test that it comes in.
#include <gtest/gtest.h>

#include <QApplication>
#include <QStyleFactory>

namespace {

void complain(QtMsgType type, const QMessageLogContext& /*where*/, const QString& message) {
    if (type == QtDebugMsg || type == QtInfoMsg) return;
    // What the platform itself cannot do says nothing of the windows.
    if (message.startsWith(QLatin1String("This plugin does not support"))) return;
    ADD_FAILURE() << "Qt: " << message.toStdString();
}

}  // namespace

int main(int argc, char** argv) {
    qputenv("QT_QPA_PLATFORM", "offscreen");
    QApplication application(argc, argv);
    QApplication::setStyle(QStyleFactory::create("Fusion"));
    QApplication::setQuitOnLastWindowClosed(false);
    qInstallMessageHandler(complain);
    testing::InitGoogleTest(&argc, argv);
    return RUN_ALL_TESTS();
}
