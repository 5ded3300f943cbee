#include "discdata/mmcontrol.h"

#include "discdata/discreader.h"
#include "discdata/drives.h"
#include "discdata/filesofdisc.h"
#include "platform/work/helperprogram.h"
#include "platform/work/longwork.h"
#include "services/messages.h"

#include <QFileInfo>

using namespace Qt::StringLiterals;

namespace
{

QHash<int, OpaqueToc> &openDevices()
{
    static QHash<int, OpaqueToc> devices;
    return devices;
}

// What `read` finds, in a worker.
template <typename Read> FoundDisc inWorker(LongWork &work, const Read &read)
{
    FoundDisc cancelled;
    cancelled.cancelled = true;
    return work.valueOf<FoundDisc>(read).value_or(cancelled);
}

bool isSheet(const QString &name)
{
    const QString ending = QFileInfo(name).suffix().toLower();
    return ending == "cue"_L1 || ending == "toc"_L1;
}

bool isNero(const QString &name)
{
    return QFileInfo(name).suffix().compare(u"nrg", Qt::CaseInsensitive) == 0;
}

// Not a disc, and yet something to look up.
FoundDisc wordsAlone(const SearchWords &words)
{
    FoundDisc found;
    found.toc.words = words;
    found.tracks = 1;
    return found;
}

} // namespace

MMControl::MMControl(Form &screen)
    : reader(HelperProgram::placeOf(u"songcase-disc"_s)), mScreen(screen)
{
}

MMControl::~MMControl()
{
    close();
}

void MMControl::Command(const QString &what)
{
    close();
    if (what.compare(u"Open", Qt::CaseInsensitive) == 0)
        open();
}

void MMControl::open()
{
    static int lastDevice = 0;
    LongWork work(mScreen, GetMessage("xDiscReading"));
    mFound = read(work);
    mDevice = ++lastDevice;
    openDevices()[mDevice] = mFound.toc;
}

void MMControl::close()
{
    openDevices().remove(mDevice);
    mDevice = 0;
    mFound = {};
}

FoundDisc MMControl::read(LongWork &work) const
{
    if (!Words.isEmpty())
        return wordsAlone(Words);
    const QString name = FileName;
    if (name.isEmpty() || name == "0"_L1)
        return {};
    if (QFileInfo(name).isDir())
        return inWorker(
            work, [name](const std::stop_token &stop) { return readSoundFolder(name, stop); });
    DiscReader disc(work, reader, patience);
    if (!isImage(name))
        return disc.readDrive(name);
    if (isNero(name) && QFileInfo(name).isFile())
        return disc.readImage(name);
    return inWorker(work, [name](const std::stop_token &) {
        return isSheet(name) ? readSheetFile(name) : readSheetOfImage(name);
    });
}

QString MMControl::problem() const
{
    return mFound.problem ? GetMessage(QLatin1String(mFound.problem)) + mFound.about : QString();
}

OpaqueToc tocOfDevice(int deviceId)
{
    return openDevices().value(deviceId);
}
