#include <gtest/gtest.h>

#include <QGuiApplication>

namespace {

QtMessageHandler before = nullptr;

/// Whatever Qt or a screen has to complain about is a failure of the test that is running.
void complain(QtMsgType type, const QMessageLogContext& context, const QString& message) {
    if (type == QtDebugMsg || type == QtInfoMsg) return before(type, context, message);
    ADD_FAILURE() << message.toStdString();
}

}  // namespace

int main(int argc, char** argv) {
    testing::InitGoogleTest(&argc, argv);
    qputenv("QT_QPA_PLATFORM", "offscreen");
    qputenv("QT_QUICK_BACKEND", "software");
    QGuiApplication application(argc, argv);
    before = qInstallMessageHandler(complain);
    return RUN_ALL_TESTS();
}
