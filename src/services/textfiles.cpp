#include "services/textfiles.h"

#include "platform/files/wholefile.h"
#include "services/fileutilities.h"

#include <QFile>
#include <QFileInfo>

namespace
{

// The end of the line that begins at `from`, without its line end.
qsizetype lineEnd(QByteArrayView s, qsizetype from)
{
    const char *p = s.data() + from, *end = s.data() + s.size();
    while (p < end && *p != '\n' && *p != '\r')
        ++p;
    return p - s.data();
}

qsizetype behindLineEnd(QByteArrayView s, qsizetype end)
{
    if (end >= s.size())
        return end;
    const bool pair = s[end] == '\r' && end + 1 < s.size() && s[end + 1] == '\n';
    return end + (pair ? 2 : 1);
}

} // namespace

QString ReadTextLine(InputTextFile &file)
{
    if (file.atEnd())
        return {};
    const auto end = lineEnd(file.mContent, file.mAt);
    const auto line = file.mContent.sliced(file.mAt, end - file.mAt);
    file.mAt = behindLineEnd(file.mContent, end);
    return text::decode(line, file.mEncoding);
}

int InputTextFile::countLines() const
{
    int lines = 0;
    for (auto at = mAt; at < mContent.size(); ++lines)
        at = behindLineEnd(mContent, lineEnd(mContent, at));
    return lines;
}

bool OpenInputFile(const QString &name, InputTextFile &file)
{
    QFile source(systemPath(name));
    if (QFileInfo(source).isDir() || !source.open(QIODevice::ReadOnly))
        return false;
    file.mBytes = source.readAll();
    file.mContent = text::withoutByteOrderMark(file.mBytes);
    file.mAt = 0;
    file.mEncoding = text::encodingOf(file.mContent);
    return source.error() == QFileDevice::NoError;
}

bool CloseTextFile(InputTextFile &file)
{
    file = {};
    return true;
}

OutputTextFile::OutputTextFile() = default;
OutputTextFile::~OutputTextFile() = default;

QString OutputTextFile::reason() const
{
    return mFile ? mFile->reason() : mReason;
}

bool OpenOutputFile(const QString &name, OutputTextFile &file)
{
    // Not a stored name but one just chosen: a "\" in it is a plain character.
    auto target = std::make_unique<WholeFile>(name);
    const bool plain = !name.isEmpty() && !QFileInfo(name).isDir();
    if (!plain || !target->open(QIODevice::WriteOnly | QIODevice::Text))
        target.reset();
    file.mFile = std::move(target);
    return file.mFile != nullptr;
}

bool WriteTextLine(OutputTextFile &file, const QString &line)
{
    const QByteArray bytes = line.toUtf8() + '\n';
    return file.mFile && file.mFile->write(bytes) == bytes.size();
}

bool CloseTextFile(OutputTextFile &file)
{
    const bool done = file.mFile && file.mFile->commit();
    file.mReason = file.reason();
    file.mFile.reset();
    return done;
}
