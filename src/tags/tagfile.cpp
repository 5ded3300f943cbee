#include "tags/tagfile.h"

#include "platform/files/systemfile.h"
#include "tags/tagerrors.h"
#include "tags/tagfields.h"
#include "tags/taglibfields.h"

namespace
{

constexpr qsizetype firstRead = qsizetype(16) << 10; // bytes; most tags without a picture fit

// The frames of sound begin with eleven bits that are set.
bool isSound(const QByteArray &start)
{
    return start.size() >= 2 && start[0] == char(0xFF) && (start[1] & 0xE0) == 0xE0;
}

// TagLib makes something of most tags that are not as they should be.
FileTag strangeTag(const SystemFile &file, const QByteArray &start)
{
    const auto fields = fieldsByTagLib(file.path());
    FileTag tag;
    tag.fields = fields.value_or(CddbID3Tag());
    tag.isWhole = !fields && !start.startsWith("ID3");
    return tag;
}

} // namespace

FileTag readTag(const SystemFile &file)
{
    QByteArray start = file.read(0, firstRead);
    const qsizetype size = tagSize(start);
    if (size == 0)
        return isSound(start) ? FileTag() : strangeTag(file, start);
    if (size > file.size())
        return strangeTag(file, start);
    if (size > start.size())
        start += file.read(start.size(), size - start.size());
    start.truncate(size);
    try {
        const TagLayout layout = layoutOf(start);
        if (auto fields = fieldsOf(start, layout))
            return {std::move(start), std::move(*fields), true};
        FileTag tag = strangeTag(file, start);
        return {std::move(start), std::move(tag.fields), true};
    } catch (const Error &) {
        return strangeTag(file, start);
    }
}

FileTag readTag(const QString &path)
{
    return readTag(SystemFile(path, SystemFile::Mode::Read));
}
