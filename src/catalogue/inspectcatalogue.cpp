#include "catalogue/cataloguefile.h"
#include "platform/desktop/programfolder.h"
#include "platform/error/error.h"
#include "services/messages.h"

#include <QDir>
#include <QFileInfo>
#include <QtEndian>

using namespace Qt::StringLiterals;

namespace cataloguefile
{

namespace
{

constexpr qsizetype headerSize = 100;
constexpr qsizetype versionOffset = 60, applicationOffset = 68;
constexpr qsizetype olderNameOffset = 4; // in a database of the older program

[[noreturn]] void refuse(ErrorNumber number, const char *key, const QString &name = {})
{
    throw Error(number, u"Songcase"_s, GetMessage(key) + name);
}

QByteArray headerOf(const QString &name)
{
    QFile file(name);
    if (!file.open(QIODevice::ReadOnly))
        throw Error(errCannotUse, u"Songcase"_s, errorText("xErrCannotOpen", file.errorString()));
    return file.read(headerSize);
}

bool mayBeWritten(const QFileInfo &file)
{
    // The bits are looked at as well: some users the system does not stop, and "WriteUser" says so.
    constexpr auto anyWrite = QFile::WriteOwner | QFile::WriteGroup | QFile::WriteOther;
    const QFileInfo folder(file.absolutePath());
    return file.isWritable() && (file.permissions() & anyWrite) && folder.isWritable() &&
           (folder.permissions() & anyWrite);
}

// A change over several files leaves journals that end in the name of a journal of all of them,
// which the engine deletes once it has put this one back. This program makes no such changes: the
// name is somebody's, and so may be the file that it names.
bool namesAnother(const QString &journal)
{
    constexpr char mark[] = "\xd9\xd5\x05\xf9\x20\xa1\x63\xd7";
    constexpr qint64 trailer = 16; // length of the name, its sum, the mark
    QFile file(journal);
    if (!file.open(QIODevice::ReadOnly) || !file.seek(file.size() - trailer))
        return false;
    const QByteArray end = file.read(trailer);
    return end.size() == trailer && end.endsWith(mark) && qFromBigEndian<quint32>(end.constData());
}

// What the engine would take up by itself as soon as it opens the file.
void inspectCompanions(const QString &name)
{
    for (const QLatin1String end : {"-journal"_L1, "-wal"_L1, "-shm"_L1}) {
        const QFileInfo companion(name + end);
        const bool there = companion.exists() || companion.isSymLink();
        const bool plain = companion.isFile() && !companion.isSymLink();
        if (there && (!plain || namesAnother(companion.filePath())))
            refuse(errCannotUse, "xForeignJournal", QDir::toNativeSeparators(companion.filePath()));
    }
}

// A person may have copied the one of the old computer over that of this program.
[[noreturn]] void refuseOlder(const QFileInfo &file)
{
    const QString folder = file.absolutePath();
    const bool users = folder == programfolder::userFolder();
    const QString way = GetMessage(users ? "xOlderInUserFolder" : "xOlderElsewhere");
    refuse(errCannotUse, "xOlderCatalogue",
           way + QDir::toNativeSeparators(users ? folder : file.absoluteFilePath()));
}

} // namespace

void inspect(const QString &name)
{
    const QFileInfo info(name);
    if (info.exists() && !info.isFile()) // to open a pipe is to wait for its other end
        refuse(errCannotUse, "xNotACatalogue");
    const QByteArray header = headerOf(name);
    if (header.mid(olderNameOffset).startsWith("Standard Jet DB"))
        refuseOlder(info);
    const bool database = header.size() == headerSize && header.startsWith("SQLite format 3");
    if (!database ||
        qFromBigEndian<qint32>(header.constData() + applicationOffset) != applicationId)
        refuse(errCannotUse, "xNotACatalogue");
    if (qFromBigEndian<quint32>(header.constData() + versionOffset) >> 24 > quint32(formatVersion))
        refuse(errCannotUse, "xNewerCatalogue");
    if (!mayBeWritten(info))
        refuse(errReadOnly, "xReadOnly");
    inspectCompanions(info.canonicalFilePath());
}

} // namespace cataloguefile
