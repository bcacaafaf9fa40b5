// Test entry: each test program gets the smallest application object its libraries allow
// (widgets, gui or none), so model tests run without a display or fonts.
#include <gtest/gtest.h>

#include <QtGlobal>
#if __has_include(<QApplication>)
#include <QApplication>
using TestApp = QApplication;
#elif __has_include(<QGuiApplication>)
#include <QGuiApplication>
using TestApp = QGuiApplication;
#else
#include <QCoreApplication>
using TestApp = QCoreApplication;
#endif

int main(int argc, char** argv)
{
    ::testing::InitGoogleTest(&argc, argv);
    if (qEnvironmentVariableIsEmpty("QT_QPA_PLATFORM")) qputenv("QT_QPA_PLATFORM", "offscreen");
    TestApp app(argc, argv);
    return RUN_ALL_TESTS();
}
