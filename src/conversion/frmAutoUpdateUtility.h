#pragma once

#include "platform/desktop/form.h"

#include <memory>
#include <optional>

namespace ADODB
{
class Connection;
class Transaction;
} // namespace ADODB
class CatalogueCopy;
class Error;
class LongWork;
struct OldTable;
namespace Ui
{
class frmAutoUpdateUtility;
}

/// Takes a catalogue of the older program over into the current one, which must be empty: all of it
/// in one transaction, or nothing. Shown modal.
class frmAutoUpdateUtility : public Form
{
    Q_OBJECT

public:
    frmAutoUpdateUtility();
    ~frmAutoUpdateUtility() override;

protected:
    void Form_Load() override;
    void Form_Unload() override;
    void closeEvent(QCloseEvent *event) override;

private:
    void connectControls();
    void setCaptions();
    void offerOldFile();
    void showNotEmpty();
    void setHeight(int pixels);

    void cmdBrowse_Click();
    void cmdStartConversion_Click();
    void cmdCancel_Click();
    bool takeFrom(const QString &folder, const QString &name);

    void showLog();
    void run();
    void convert(LongWork &work);
    bool openOld(LongWork &work);
    bool copyAll(CatalogueCopy &copy);
    void finish();
    void CancelConversion();
    void tellFailure(const Error &error);

    void setProgress(float percent);
    void addRow(const OldTable &table, qint64 row, qint64 rows, qint64 total);
    void log(const QString &line);
    void showLogText(const QString &text);

    std::unique_ptr<Ui::frmAutoUpdateUtility> mUi;
    QString mOldDatabasePath;
    std::unique_ptr<ADODB::Connection> mOldConnection;
    std::unique_ptr<ADODB::Transaction> mTransaction; // of the copying routine
    bool mCancelRequested = false, mConverting = false;
    LongWork *mWork = nullptr;
    bool mUnloadAtEnd = false; // of the routine that runs

    float mProgress = 0;
    QString mLogBase; // without the line that tells how far a table has come
    std::optional<int> mShownPercent;
};
