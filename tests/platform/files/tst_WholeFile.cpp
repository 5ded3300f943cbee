// Label: unit
#include "catalogue/cataloguefile.h"
#include "catalogue/provision.h"
#include "platform/ado/connection.h"
#include "platform/ado/recordset.h"
#include "platform/desktop/programfolder.h"
#include "reports/reportoutput.h"
#include "services/clsRegistry.h"
#include "services/globals.h"
#include "services/textfiles.h"
#include "support/datarows.h"
#include "support/diskfaults.h"
#include "support/scripteddesktop.h"
#include "support/testcatalogue.h"

#include <QDir>
#include <QDirIterator>
#include <QTest>

using diskfaults::Fault;
using diskfaults::Kind;

namespace
{

/// Something that the program writes.
struct Writing {
    QString file;
    std::function<void()> before; // puts back what was there
    std::function<bool()> write;  // whether it says that it did
};

int filesBelow(const QString &folder)
{
    int count = 0;
    for (QDirIterator it(folder, QDir::AllEntries | QDir::Hidden | QDir::NoDotAndDotDot,
                         QDirIterator::Subdirectories);
         it.hasNext(); it.next())
        ++count;
    return count;
}

bool writeText(const QString &name)
{
    OutputTextFile file;
    bool written = OpenOutputFile(name, file);
    for (const QChar letter : u"abc"_s) // more than a buffer holds
        written &= WriteTextLine(file, QString(20000, letter));
    return CloseTextFile(file) && written;
}

bool storeNumber(int number)
{
    bool failed = false;
    clsRegistry settings;
    QObject::connect(&settings, &clsRegistry::regFout, &settings, [&] { failed = true; });
    settings.SetValue(settingsKey, u"Number"_s, number);
    return !failed;
}

bool provision()
{
    try {
        provisionCatalogue();
    } catch (const Error &) {
        return false;
    }
    return true;
}

bool writeReport(const QString &name)
{
    const QPageLayout paper(QPageSize(QPageSize::A4), QPageLayout::Portrait, QMarginsF(9, 9, 9, 9));
    const auto rows = gConnection->Execute(u"select 'A title' as titel"_s);
    const auto content = std::make_shared<ReportContent>(rows, u"Caption"_s, QDate(2026, 11, 22));
    const ReportPainter report(content, ReportLayout(paper, 1, false));
    const auto result =
        reportoutput::writePdf(name, report, paper, [](qsizetype, qsizetype) { return true; });
    return result.outcome == reportoutput::Outcome::Done;
}

} // namespace

/// Everything that the program writes beside the catalogue, with a disk that fails at each call in
/// turn: there is the old or the new, whole, and what was said to be written is.
class tst_WholeFile : public QObject
{
    Q_OBJECT

private:
    Writing writing(const QString &what)
    {
        const QString file = mDesktop->folder + u"/file"_s;
        const auto old = [=] { writeFile(file, "old"); };
        if (what == "text"_L1)
            return {file, old, [=] { return writeText(file); }};
        if (what == "PDF"_L1)
            return {file, old, [=] { return writeReport(file); }};
        if (what == "settings"_L1)
            return {mDesktop->settings, [] { storeNumber(10); }, [] { return storeNumber(200); }};
        const QString home = mDesktop->folder + u"/home"_s;
        qputenv("XDG_DATA_HOME", QFile::encodeName(home));
        mDesktop->folder = programfolder::userFolder();
        return {programfolder::catalogueIn(mDesktop->folder),
                [=] { QDir(home).removeRecursively(); }, provision};
    }

    std::unique_ptr<ScriptedDesktop> mDesktop;
    std::unique_ptr<TestCatalogue> mCatalogue;

private slots:
    void init()
    {
        mDesktop = std::make_unique<ScriptedDesktop>();
        mCatalogue.reset(); // first: each one holds gConnection
        mCatalogue = std::make_unique<TestCatalogue>();
        clsRegistry().CreateKey(settingsKey);
    }

    void theDiskFailsAtEachCall_data()
    {
        const DataRows<QString, bool> row("what", "full");
        row("settings, full", "settings", true);
        row("settings, broken", "settings", false);
        row("text file, full", "text", true);
        row("text file, broken", "text", false);
        row("PDF, full", "PDF", true);
        row("PDF, broken", "PDF", false);
        row("first start, full", "first start", true);
        row("first start, broken", "first start", false);
    }

    void theDiskFailsAtEachCall()
    {
        QFETCH(QString, what);
        QFETCH(bool, full);
        const QString root = QFileInfo(mDesktop->settings).dir().absoluteFilePath(u".."_s);
        const Writing one = writing(what);
        one.before();
        const QByteArray old = readFile(one.file);
        QVERIFY(one.write());
        const QByteArray whole = readFile(one.file);
        const auto files = filesBelow(root);

        bool came = true;
        int n = 0;
        while (came) {
            one.before();
            bool told = false;
            {
                const Fault fault(root, full ? Kind::Full : Kind::Broken, ++n);
                told = one.write();
                came = fault.came();
            }
            const QByteArray now = readFile(one.file);
            // The files of one report differ by the second in which they were made.
            const bool isNew = now.size() == whole.size() && now.right(6) == whole.right(6);
            QVERIFY2(isNew || now == old,
                     qPrintable(u"call %1: %2 bytes"_s.arg(n).arg(now.size())));
            QVERIFY2(isNew || !told, qPrintable(u"call %1 is overlooked"_s.arg(n)));
            QVERIFY2(filesBelow(root) <= files, qPrintable(u"call %1 leaves something"_s.arg(n)));
        }
        QVERIFY2(n > 4, qPrintable(u"only %1 calls"_s.arg(n)));
    }
};

QTEST_MAIN(tst_WholeFile)
#include "tst_WholeFile.moc"
