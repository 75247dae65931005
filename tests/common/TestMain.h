#pragma once

#include <QApplication>
#include <QCoreApplication>
#include <QStandardPaths>
#include <QtTest>

// Runs a test the same inside and outside CTest: offscreen unless the caller
// names a platform, and with settings and data folders of its own, so that a
// test never touches the user's settings or stores.
inline void prepareTestEnvironment()
{
    if (!qEnvironmentVariableIsSet("QT_QPA_PLATFORM"))
        qputenv("QT_QPA_PLATFORM", "offscreen");
    QStandardPaths::setTestModeEnabled(true);
}

#define QC_TEST_MAIN(TestObject)                                                                   \
    int main(int argc, char* argv[])                                                               \
    {                                                                                              \
        prepareTestEnvironment();                                                                  \
        QApplication app(argc, argv);                                                              \
        app.setAttribute(Qt::AA_Use96Dpi, true);                                                   \
        TestObject test;                                                                           \
        QTEST_SET_MAIN_SOURCE_PATH                                                                 \
        return QTest::qExec(&test, argc, argv);                                                    \
    }

#define QC_TEST_GUILESS_MAIN(TestObject)                                                           \
    int main(int argc, char* argv[])                                                               \
    {                                                                                              \
        prepareTestEnvironment();                                                                  \
        QCoreApplication app(argc, argv);                                                          \
        TestObject test;                                                                           \
        QTEST_SET_MAIN_SOURCE_PATH                                                                 \
        return QTest::qExec(&test, argc, argv);                                                    \
    }
