#pragma once

#include <QApplication>
#include <QTest>

#include <unistd.h>

/// main() of a window test: WebEngine needs shared GL contexts before the application exists, and
/// no sandbox when the tests run as root. The program's own rules apply: closing a window does
/// not quit.
#define VERBLOOM_SHELL_TEST_MAIN(TestObject)                                                      \
    int main(int argc, char *argv[])                                                              \
    {                                                                                             \
        if (geteuid() == 0)                                                                       \
            qputenv("QTWEBENGINE_DISABLE_SANDBOX", "1");                                          \
        QCoreApplication::setAttribute(Qt::AA_ShareOpenGLContexts);                               \
        QApplication app(argc, argv);                                                             \
        QApplication::setQuitOnLastWindowClosed(false);                                           \
        TestObject test;                                                                          \
        QTEST_SET_MAIN_SOURCE_PATH                                                                \
        return QTest::qExec(&test, argc, argv);                                                   \
    }
