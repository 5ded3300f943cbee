#include "discdata/keptanswers.h"

#include "discs/recordjson.h"
#include "platform/desktop/desktop.h"
#include "platform/files/wholefile.h"

#include <QCryptographicHash>
#include <QDir>

using namespace Qt::StringLiterals;

namespace
{

constexpr char format[] = "Songcase answer 1";
constexpr qint64 longest = 16 << 20; // bytes

QByteArray checksum(const QByteArray &bytes)
{
    return QCryptographicHash::hash(bytes, QCryptographicHash::Sha1).toHex();
}

// Format, checksum of what follows it; date, question, records: a line each, the last one the rest.
QByteArray fileContent(const QString &question, const QDate &date, const QByteArray &records)
{
    const QByteArray content = date.toString(Qt::ISODate).toLatin1() + '\n' +
                               question.toUtf8().replace('\n', ' ') + '\n' + records;
    return QByteArray(format) + '\n' + checksum(content) + '\n' + content;
}

QByteArray takeLine(QByteArray &bytes)
{
    const qsizetype end = bytes.indexOf('\n');
    QByteArray line = bytes.left(end);
    bytes = end < 0 ? QByteArray() : bytes.mid(end + 1);
    return line;
}

// Nothing but a whole file of ours that answers this very question.
std::optional<KeptAnswers::Answer> readContent(QByteArray bytes, const QString &question)
{
    const QByteArray begins = takeLine(bytes), sum = takeLine(bytes);
    if (begins != format || sum != checksum(bytes))
        return {};
    const QDate date = QDate::fromString(QString::fromLatin1(takeLine(bytes)), Qt::ISODate);
    if (!date.isValid() || takeLine(bytes) != question.toUtf8().replace('\n', ' '))
        return {};
    auto records = recordsFromJson(bytes);
    if (!records || records->empty())
        return {};
    return KeptAnswers::Answer{std::move(*records), date};
}

} // namespace

QString KeptAnswers::fileFor(const QString &question) const
{
    return mFolder + u'/' + QString::fromLatin1(checksum(question.toUtf8())) + u".answer"_s;
}

void KeptAnswers::keep(const QString &question, const std::vector<DiscRecord> &records) const
{
    if (mFolder.isEmpty() || records.empty() || !QDir().mkpath(mFolder))
        return;
    WholeFile file(fileFor(question));
    if (!file.open(QIODevice::WriteOnly))
        return;
    file.write(fileContent(question, Desktop::current().now().date(), toJson(records)));
    if (file.commit())
        dropOldest();
}

// Parts of files that a crash has left count as well.
void KeptAnswers::dropOldest() const
{
    const QDir folder(mFolder);
    const QStringList newest = folder.entryList({u"*.answer*"_s}, QDir::Files, QDir::Time);
    for (qsizetype i = mMost; i < newest.size(); ++i)
        QFile::remove(folder.filePath(newest[i]));
}

std::optional<KeptAnswers::Answer> KeptAnswers::find(const QString &question) const
{
    QFile file(fileFor(question));
    if (mFolder.isEmpty() || !file.open(QIODevice::ReadOnly) || file.size() > longest)
        return {};
    return readContent(file.readAll(), question);
}
