#pragma once

#include <QByteArray>
#include <QString>
#include <compare>
#include <optional>

/// What tells a file from another, and whether it has been written since.
struct FileStamp {
    quint64 device = 0, inode = 0;
    qint64 size = 0;                  // bytes
    qint64 modified = 0, changed = 0; // nanoseconds; content, anything

    bool isSameFile(const FileStamp &other) const
    {
        return device == other.device && inode == other.inode;
    }
    bool operator==(const FileStamp &) const = default;
};

/// An ordinary file that is open, closed with this object. Reads and writes whole pieces, however
/// many calls it takes, and throws Error (errFileFailed) with the words of the system. Reading
/// leaves no trace in the time of the last access where the system lets it.
class SystemFile
{
public:
    enum class Mode {
        Read,
        Write,
        Create
    }; // Create: there must be none yet; only its owner may read it

    SystemFile(const QString &path, Mode mode);
    SystemFile(SystemFile &&other) noexcept;
    SystemFile &operator=(SystemFile &&) = delete;
    ~SystemFile();

    QString path() const { return mPath; }
    int handle() const { return mHandle; }
    FileStamp stamp() const;
    qint64 size() const { return stamp().size; }

    QByteArray read(qint64 from, qint64 count) const; // less only at the end of the file
    void write(qint64 from, const QByteArray &bytes);
    void resize(qint64 size); // a longer file has its room for sure
    void sync();

    /// Appends the bytes of another file, which the disk may share and not copy.
    void append(const SystemFile &other, qint64 from, qint64 count);

    [[noreturn]] void fail() const; // with the last error of the system

private:
    QString mPath;
    int mHandle = -1;
};

/// Of what a name leads to; throws Error where there is nothing.
FileStamp stampOf(const QString &path);

/// The same; nothing where no ordinary file has this name.
std::optional<FileStamp> stampOfOrdinaryFile(const QString &path);

/// Where a name leads to, without links; the name itself where there is nothing.
QString realPath(const QString &path);
