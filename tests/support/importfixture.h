#pragma once

#include "services/frame.h"
#include "support/screentest.h"

#include <QWidget>

/// What the wizard leaves behind: the file and one of the four formats. A and B have one field per
/// row, C and D one track; A and C hold compilations, B and D albums.
void chooseImport(char format, const QString &file);

/// The rows of gImportRecords, values joined by "|".
QStringList importRows();

/// A frame of which only the Import entry and the pointer matter.
class TestFrame : public Frame
{
public:
    TestFrame() { setCurrent(this); }
    ~TestFrame() override { setCurrent(nullptr); }

    QWidget *window() override { return &mWindow; }
    QSize size() const override { return {900, 600}; }
    void setImportEnabled(bool enabled) override { importEnabled = enabled; }
    bool hourglass() const { return mWindow.cursor().shape() == Qt::WaitCursor; }

    bool importEnabled = true;

private:
    QWidget mWindow;
};

/// A test of a screen of the text import, with a frame around it.
class ImportTest : public ScreenTest
{
    Q_OBJECT

protected slots:
    void init();
    void cleanup();

protected:
    /// Chooses a file with this content.
    void chooseContent(char format, const QByteArray &content)
    {
        chooseImport(format, writeFile(mCatalogue->path("in.txt"), content));
    }

    std::unique_ptr<TestFrame> mFrame;
};
