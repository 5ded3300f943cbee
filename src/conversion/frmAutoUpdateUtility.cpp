#include "conversion/frmAutoUpdateUtility.h"

#include "conversion/cataloguecopy.h"
#include "conversion/oldcatalogue.h"
#include "conversion/ui_frmAutoUpdateUtility.h"
#include "platform/ado/connection.h"
#include "platform/ado/recordset.h"
#include "platform/work/longwork.h"
#include "services/browser.h"
#include "services/captions.h"
#include "services/fileutilities.h"
#include "services/frame.h"
#include "services/globals.h"
#include "services/messages.h"

#include <QCloseEvent>
#include <QDir>
#include <QLocale>
#include <cmath>

using namespace Qt::StringLiterals;

namespace
{

constexpr int smallHeight = 153, logHeight = 404, errorHeight = 113; // 2295, 6060, 1700 twips
constexpr int besideError = 13;                                      // 200 twips
constexpr float shareOfRows = 95, full = 100;
constexpr auto firstGeneration = "Compact.orv"_L1, secondGeneration = "Compact3.orv"_L1;

// By design: the generation goes by the name alone, and by its case.
bool hasMP3Tables(const QString &file)
{
    return !file.contains(firstGeneration);
}

bool isCatalogueEmpty()
{
    auto artists = gConnection->Execute(u"select count(*) as aantal from artiesten"_s);
    return artists.Fields(u"Aantal").Value().toLong() < 1;
}

QString presentTime()
{
    const QLocale system = QLocale::system();
    const auto language = gLanguage == languageDutch ? QLocale::Dutch : QLocale::English;
    const QLocale locale = system.language() == language ? system : QLocale(language);
    const QDateTime now = Desktop::current().now();
    return locale.toString(now.date(), QLocale::ShortFormat) + u' ' +
           now.time().toString(u"HH:mm:ss"_s);
}

} // namespace

frmAutoUpdateUtility::frmAutoUpdateUtility()
    : Form(u"frmAutoUpdateUtility"_s), mUi(std::make_unique<Ui::frmAutoUpdateUtility>())
{
    mUi->setupUi(this);
    mUi->Progress->hide();
    setDefaultButton(mUi->cmdStartConversion);
    setCancelButton(mUi->cmdCancel);
    connectControls();
}

frmAutoUpdateUtility::~frmAutoUpdateUtility() = default;

void frmAutoUpdateUtility::connectControls()
{
    using Self = frmAutoUpdateUtility;
    connect(mUi->cmdBrowse, &QPushButton::clicked, this, &Self::cmdBrowse_Click);
    connect(mUi->cmdStartConversion, &QPushButton::clicked, this, &Self::cmdStartConversion_Click);
    connect(mUi->cmdCancel, &QPushButton::clicked, this, &Self::cmdCancel_Click);
    connect(mUi->txtOldDatabaseFileName, &QLineEdit::textChanged, this,
            [this] { mUi->cmdStartConversion->setEnabled(true); });
}

void frmAutoUpdateUtility::Form_Load()
{
    mOldConnection = std::make_unique<ADODB::Connection>();
    placeInFrame(this, 0.15, 0.2);
    setCaptions();
    setHeight(smallHeight);
    try {
        if (isCatalogueEmpty())
            offerOldFile();
        else
            showNotEmpty();
    } catch (const Error &error) { // another program may keep the catalogue locked
        errorBox(error.numbered(), GetMessage("MsgSysErr"));
        Unload();
    }
}

void frmAutoUpdateUtility::setCaptions()
{
    applyCaptions(this, {{"lblAutoUpdateUtilityText", "lblAutoUpdateUtilityText"},
                         {"frmAutoUpdateUtility", "frmAutoUpdateUtilityCaption"},
                         {"cmdCancel", "cmdCancelCaption"},
                         {"cmdBrowse", "cmdBrowseCaption"},
                         {"cmdStartConversion", "cmdStartConversionCaption"},
                         {"lblFileToConvert", "lblFileToConvertCaption"}});
    mUi->TheProgressBar->setAccessibleName(GetMessage("xProgress"));
    mUi->ReportList->setAccessibleName(GetMessage("xConversionLog"));
}

void frmAutoUpdateUtility::offerOldFile()
{
    mOldDatabasePath = Desktop::current().programFolder() + QDir::separator() + firstGeneration;
    if (FileExists(mOldDatabasePath))
        mUi->txtOldDatabaseFileName->setText(mOldDatabasePath);
    setFramePointer(vbDefault);
}

// By design: nothing but the close button of the window is left.
void frmAutoUpdateUtility::showNotEmpty()
{
    QPalette red = mUi->lblAutoUpdateUtilityText->palette();
    red.setColor(QPalette::WindowText, Qt::red);
    mUi->lblAutoUpdateUtilityText->setPalette(red);
    applyCaptions(this, {{"lblAutoUpdateUtilityText", "lblAutoUpdateUtilityErrorText"}});
    for (QWidget *control :
         std::initializer_list<QWidget *>{mUi->txtOldDatabaseFileName, mUi->lblFileToConvert,
                                          mUi->cmdBrowse, mUi->cmdCancel, mUi->cmdStartConversion})
        control->hide();
    const int left = besideError / 2;
    mUi->outer->setContentsMargins(left, left, besideError - left, left);
    setHeight(errorHeight);
}

// As much more as the texts need, in a larger font.
void frmAutoUpdateUtility::setHeight(int pixels)
{
    layout()->activate();
    const int need = layout()->hasHeightForWidth() ? layout()->totalHeightForWidth(width())
                                                   : layout()->totalMinimumSize().height();
    const QSize size(width(), std::max(pixels, need));
    if (isWindow() && isVisible())
        placeOnScreen(this, pos(), size); // the log would end below the edge of a small screen
    else
        resize(size);
}

void frmAutoUpdateUtility::cmdBrowse_Click()
{
    const QString folder =
        BrowseForFolderDialog(GetMessage("MapSelecteren"), Desktop::current().programFolder());
    if (folder.isEmpty() || takeFrom(folder, secondGeneration) || takeFrom(folder, firstGeneration))
        return;
    errorBox(GetMessage("cvtFileNotFindInThisFolder"));
}

bool frmAutoUpdateUtility::takeFrom(const QString &folder, const QString &name)
{
    const QString file = QDir(folder).filePath(name);
    if (!FileExists(file))
        return false;
    mUi->txtOldDatabaseFileName->setText(QDir::toNativeSeparators(file));
    mUi->cmdStartConversion->setEnabled(true);
    return true;
}

void frmAutoUpdateUtility::cmdStartConversion_Click()
{
    if (!LongWork::mayBegin(*this))
        return;
    mConverting = false;
    mOldDatabasePath = mUi->txtOldDatabaseFileName->text();
    if (!FileExists(mOldDatabasePath)) {
        errorBox(GetMessage("cvtInvalidFileName"));
        return;
    }
    showLog();
    run();
    if (mUnloadAtEnd)
        Unload();
}

void frmAutoUpdateUtility::showLog()
{
    for (QWidget *control : std::initializer_list<QWidget *>{
             mUi->cmdBrowse, mUi->cmdStartConversion, mUi->txtOldDatabaseFileName})
        control->setEnabled(false);
    mUi->cmdCancel->setFocus();
    mUi->Progress->show();
    setHeight(logHeight);
}

void frmAutoUpdateUtility::run()
{
    LongWork work(*this);
    work.showPercent = [](int) {}; // each row moves the bar by itself
    mWork = &work;
    try {
        convert(work);
    } catch (const Error &error) {
        tellFailure(error);
    }
    mTransaction.reset();
    mWork = nullptr;
}

void frmAutoUpdateUtility::convert(LongWork &work)
{
    log(u"Opening old database"_s);
    if (!openOld(work))
        return;
    setProgress(1);
    log(u"Start at: "_s + presentTime());
    log(u"Analyzing data...."_s);

    CatalogueCopy copy(*mOldConnection, *gConnection, hasMP3Tables(mOldDatabasePath));
    copy.mayGoOn = [&] { return work.step() && !mCancelRequested; }; // asked behind the pump
    copy.counted = [this](const OldTable &table, qint64 rows) {
        log(u"Found "_s + QString::number(rows) + QLatin1String(table.found));
    };
    copy.copied = [&](const OldTable &table, qint64 row, qint64 rows) {
        addRow(table, row, rows, copy.total());
    };
    copy.tableCopied = [this] {
        Desktop::current().pump();
        mLogBase = mUi->ReportList->toPlainText();
        mShownPercent.reset();
    };
    if (!copy.count())
        return;
    if (copy.total() < 1)
        setProgress(full);
    else if (!copyAll(copy))
        return;
    finish();
}

bool frmAutoUpdateUtility::openOld(LongWork &work)
{
    Desktop::current().pump(); // what was said stands on the screen while the file is read
    return openOldCatalogue(*mOldConnection, mOldDatabasePath, hasMP3Tables(mOldDatabasePath),
                            work) &&
           !mCancelRequested;
}

bool frmAutoUpdateUtility::copyAll(CatalogueCopy &copy)
{
    mTransaction = std::make_unique<ADODB::Transaction>(*gConnection);
    mConverting = true;
    const bool all = copy.copy() && !mCancelRequested;
    if (!all) {
        CancelConversion(); // where the end of the program has cancelled
        return false;
    }
    mTransaction->CommitTrans();
    mUi->cmdCancel->setText(u"&OK"_s);
    mConverting = false;
    refreshBrowser();
    Desktop::current().pump();
    return true;
}

void frmAutoUpdateUtility::finish()
{
    mOldConnection->Close();
    log(u"Ready at "_s + presentTime());
}

void frmAutoUpdateUtility::cmdCancel_Click()
{
    mCancelRequested = true;
    Desktop::current().pump();
    if (mConverting) {
        CancelConversion();
    } else if (mWork) {
        mUnloadAtEnd = true;
        mWork->cancel(); // it may wait for a file that brings nothing
    } else {
        Unload();
    }
}

void frmAutoUpdateUtility::CancelConversion()
{
    Desktop::current().pump();
    if (!mConverting)
        return; // the pump has let another Cancel in
    mTransaction->RollbackTrans();
    mConverting = false;
    log(u"Conversion cancelled."_s);
    log(u"Stopped at "_s + presentTime());
    Desktop::current().pump();
}

// A cancel at the window itself ends the screen too.
void frmAutoUpdateUtility::closeEvent(QCloseEvent *event)
{
    if (!isBusy()) {
        Form::closeEvent(event);
        return;
    }
    event->ignore();
    mUnloadAtEnd = true;
    cmdCancel_Click();
}

void frmAutoUpdateUtility::Form_Unload()
{
    mCancelRequested = true;
    if (mConverting)
        CancelConversion();
    if (mOldConnection->State() == ADODB::adStateOpen)
        mOldConnection->Close();
}

void frmAutoUpdateUtility::tellFailure(const Error &error)
{
    log(u"Fatal error: "_s + error.Description);
    log(u"No data were imported."_s);
    log(u"Stopped at "_s + presentTime());
    QPalette alarm = mUi->ReportList->palette();
    alarm.setColor(QPalette::Base, Qt::black);
    alarm.setColor(QPalette::Text, Qt::red);
    mUi->ReportList->setPalette(alarm);
    mUi->ReportList->setReadOnly(true);
    mConverting = false;
    if (mTransaction)
        mTransaction->RollbackTrans();
}

void frmAutoUpdateUtility::setProgress(float percent)
{
    mProgress = std::min(percent, full);
    mUi->TheProgressBar->setValue(int(mProgress));
}

// The figure tells the rows before this one, so the last one of a table need not be 100.
void frmAutoUpdateUtility::addRow(const OldTable &table, qint64 row, qint64 rows, qint64 total)
{
    setProgress(mProgress + shareOfRows / float(total));
    const int percent = int(std::nearbyint(100.0 * double(row) / double(rows)));
    if (mShownPercent == percent)
        return;
    mShownPercent = percent;
    showLogText(mLogBase + QString::number(percent) + QLatin1String(table.done) + u'\n');
}

void frmAutoUpdateUtility::log(const QString &line)
{
    mLogBase = mUi->ReportList->toPlainText() + line + u'\n';
    showLogText(mLogBase);
}

void frmAutoUpdateUtility::showLogText(const QString &text)
{
    mUi->ReportList->setPlainText(text);
    mUi->ReportList->moveCursor(QTextCursor::End);
}
