#pragma once

#include "support/testcatalogue.h"

#include <QApplication>
#include <QTemporaryDir>
#include <QTest>

/// For the main() of a test that needs a screen of a certain size.
template <typename Test> int runOnScreen(int width, int height, int argc, char *argv[])
{
    const QTemporaryDir folder;
    const QByteArray size =
        "\"width\": " + QByteArray::number(width) + ", \"height\": " + QByteArray::number(height);
    const QString file = writeFile(folder.filePath(u"screens.json"_s),
                                   R"({"screens": [{"name": "one", "x": 0, "y": 0, )" + size +
                                       R"(, "logicalDpi": 96, "logicalBaseDpi": 96, "dpr": 1}]})");
    qputenv("QT_QPA_PLATFORM", "offscreen:configfile=" + file.toLocal8Bit());
    QApplication application(argc, argv);
    Test test;
    return QTest::qExec(&test, argc, argv);
}
