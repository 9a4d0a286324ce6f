#include <QApplication>

#include <unistd.h>

#include <gtest/gtest.h>

// Every test runs inside one QApplication on the offscreen platform, with the
// configuration folders pointed at a throw-away place so nothing touches the user's own.
int main(int argc, char** argv) {
    qputenv("QT_QPA_PLATFORM", "offscreen");
    static QByteArray home =
        QByteArray("/tmp/lum-test-home-") + QByteArray::number(qint64(getpid()));
    qputenv("XDG_CONFIG_HOME", home + "/config");
    qputenv("XDG_DATA_HOME", home + "/data");
    QApplication app(argc, argv);
    ::testing::InitGoogleTest(&argc, argv);
    return RUN_ALL_TESTS();
}
