#pragma once

#include "catalogue/cataloguelock.h"
#include "platform/desktop/form.h"
#include "services/frame.h"
#include "shell/startup.h"

#include <QMainWindow>
#include <memory>

class QMdiSubWindow;
class QTimer;

namespace Ui
{
class MainScreen;
}

/// The frame and the process: the program starts by loading it and ends when it unloads. It owns
/// the one connection to the catalogue from its load to its unload, and hosts the modeless screens.
class MainScreen : public QMainWindow, public Frame, public Form::Host
{
    Q_OBJECT

public:
    explicit MainScreen(bool lastRunBroken = false);
    ~MainScreen() override;

    /// All of the start but the timer step. False if the program is to end at once.
    bool Load();

    /// All screens are asked, and only when all agree is anything unloaded; false if one refuses.
    /// `Forced` asks none.
    bool Unload(bool forced = false);
    void bringToFront();

    // Frame
    QWidget *window() override { return this; }
    QSize size() const override { return QMainWindow::size(); }
    void setImportEnabled(bool enabled) override;
    QAction *command(const QString &name) override;

    // Form::Host
    void adopt(Form *form) override;
    void bringUp(Form *form) override;
    QPoint origin() const override { return pos(); }

signals:
    void languageKnown();
    void unloaded();

protected:
    void closeEvent(QCloseEvent *event) override;

private:
    void setUpControls();
    void connectActions();
    void InitMainScreen();
    void setCaptions();
    void nameKeys();
    void markLanguage();
    void Timer1_Timer();
    void openBrowser();
    void ChangeLanguage(int language);
    void Over_Click();
    bool unloadChildren(bool forced);
    void closeCatalogue();
    QMdiSubWindow *subWindowOf(Form *form) const;

    std::unique_ptr<Ui::MainScreen> mUi;
    QTimer *mTimer1;
    bool mDatabaseMissing = false;
    startup::Found mStart;
    CatalogueLock mProvisioned; // of a catalogue made by this start
    bool mLastRunBroken;
    bool mStarted = false; // by the timer step
    bool mUnloading = false, mUnloaded = false;
};
