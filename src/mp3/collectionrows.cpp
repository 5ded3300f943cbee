#include "mp3/collectionrows.h"

#include "platform/work/longwork.h"
#include "services/fileutilities.h"
#include "services/globals.h"

#include <QDir>
#include <QHash>
#include <algorithm>
#include <numeric>

using namespace Qt::StringLiterals;

namespace
{

constexpr int volgnummerColumn = int(CollectionField::Volgnummer);
constexpr int nameColumn = int(CollectionField::FileName);

// The aliases give a text column for each field of a tag, which no table has.
QString selectFiles(qint64 collection)
{
    return u"select mfs.volgnummer as Volgnummer, mfs.FileName as FileName, mfs.filename as Album, "
           "mfs.filename as LeadArtist, mfs.filename as Title, mfs.filename as TrackPosition, "
           "mfs.filename as PartOfSet, mfs.filename as TrackYear, mfs.filename as Genre, "
           "mfs.filename as CopyrightHolder, mfs.filename as Label, mfs.filename as Comments, "
           "mfs.filename as DoesFileExist, mfs.filename as ID from mp3files mfs where "
           "mfs.CollectionId = "_s +
           QString::number(collection) + u" order by 1,2 asc"_s;
}

constexpr std::pair<CollectionField, TagField> tagColumns[] = {
    {CollectionField::Album, TagField::Album},
    {CollectionField::LeadArtist, TagField::LeadArtist},
    {CollectionField::Title, TagField::Title},
    {CollectionField::TrackPosition, TagField::TrackPosition},
    {CollectionField::PartOfSet, TagField::PartOfSet},
    {CollectionField::TrackYear, TagField::Year},
    {CollectionField::Genre, TagField::Genre},
    {CollectionField::CopyrightHolder, TagField::CopyrightHolder},
    {CollectionField::Label, TagField::Label},
    {CollectionField::Comments, TagField::Comments},
    {CollectionField::ID, TagField::FileId}};

bool sameRow(const ADODB::Rows &a, const ADODB::Rows &b, qsizetype row)
{
    return a.value(row, volgnummerColumn) == b.value(row, volgnummerColumn) &&
           a.value(row, nameColumn) == b.value(row, nameColumn);
}

} // namespace

// What the statement gives for the fields of a tag is not kept: they are empty until the file was
// read.
void CollectionRows::load(qint64 collection)
{
    ADODB::Recordset stored;
    stored.Open(selectFiles(collection), *gConnection, ADODB::adOpenStatic,
                ADODB::adLockOptimistic);
    WorkingRecords = std::make_shared<ADODB::Recordset>();
    for (const ADODB::FieldInfo &field : stored.rows()->fields())
        WorkingRecords->appendField(field.name, field.type, field.size);
    WorkingRecords->Open();
    for (; !stored.isEOF(); stored.MoveNext()) {
        WorkingRecords->AddNew();
        for (const int column : {volgnummerColumn, nameColumn})
            WorkingRecords->Fields(column).setValue(stored.Fields(column).Value());
        WorkingRecords->Update();
    }
    BaselineRecords = std::make_shared<ADODB::Recordset>(*WorkingRecords);
    mFiles.assign(std::size_t(count()), {});
}

QString CollectionRows::fileName(qsizetype row) const
{
    return WorkingRecords->rows()->text(row, nameColumn);
}

QSet<QString> CollectionRows::fileNames() const
{
    QSet<QString> names;
    for (qsizetype row = 0; row < count(); ++row) {
        const QString name = fileName(row);
        names.insert(name);
        names.insert(QString(name).replace(u'\\', QDir::separator()));
    }
    return names;
}

bool CollectionRows::isMissing(qsizetype row) const
{
    return mFiles[std::size_t(row)].state == FileMemory::Missing;
}

bool CollectionRows::haveChanged() const
{
    const auto now = WorkingRecords->rows(), before = BaselineRecords->rows();
    if (now->rowCount() != before->rowCount())
        return true;
    for (qsizetype row = 0; row < now->rowCount(); ++row) {
        if (!sameRow(*now, *before, row))
            return true;
    }
    return false;
}

void CollectionRows::append(const QStringList &fileNames)
{
    for (const QString &name : fileNames) {
        const qint64 number = count() + 1;
        WorkingRecords->AddNew();
        WorkingRecords->Fields(volgnummerColumn).setValue(number);
        WorkingRecords->Fields(nameColumn).setValue(name);
        WorkingRecords->Update();
    }
    mFiles.resize(std::size_t(count()));
}

void CollectionRows::remove(const QStringList &fileNames)
{
    QHash<QString, int> toGo;
    for (const QString &name : fileNames)
        ++toGo[name];
    std::vector<std::uint32_t> stay;
    for (qsizetype row = 0; row < count(); ++row) {
        const auto left = toGo.find(fileName(row));
        if (left == toGo.end() || left.value() == 0)
            stay.push_back(std::uint32_t(row));
        else
            --left.value();
    }
    arrange(stay);
}

void CollectionRows::removeAll()
{
    arrange({});
}

void CollectionRows::move(qsizetype from, qsizetype to)
{
    std::vector<std::uint32_t> order(mFiles.size());
    std::iota(order.begin(), order.end(), 0);
    const auto first = order.begin();
    if (from < to)
        std::rotate(first + from, first + from + 1, first + to + 1);
    else
        std::rotate(first + to, first + from, first + from + 1);
    arrange(order);
}

void CollectionRows::arrange(const std::vector<std::uint32_t> &order)
{
    std::vector<FileMemory> files;
    files.reserve(order.size());
    for (const auto row : order)
        files.push_back(mFiles[row]);
    mFiles = std::move(files);
    WorkingRecords->arrange(order);
    qint64 number = 0;
    for (; !WorkingRecords->isEOF(); WorkingRecords->MoveNext())
        WorkingRecords->Fields(volgnummerColumn).setValue(++number);
}

void CollectionRows::setFileNames(const QHash<QString, QString> &names)
{
    if (count() > 0)
        WorkingRecords->MoveFirst();
    for (std::size_t row = 0; !WorkingRecords->isEOF(); WorkingRecords->MoveNext(), ++row) {
        const auto name = names.find(WorkingRecords->Fields(volgnummerColumn).Value().toText());
        if (name == names.end())
            continue;
        WorkingRecords->Fields(nameColumn).setValue(*name);
        mFiles[row] = {};
    }
}

void CollectionRows::followNames(const RenamedFiles &renamed, const QString &folder)
{
    for (const auto &records : {WorkingRecords, BaselineRecords}) {
        if (records->RecordCount() > 0)
            records->MoveFirst();
        for (; !records->isEOF(); records->MoveNext()) {
            auto name = records->Fields(nameColumn);
            name.setValue(followedName(renamed, folder, name.Value().toText()));
        }
    }
}

CollectionRows::Reading CollectionRows::read(const QString &folder, LongWork &work)
{
    Reading reading;
    if (count() > 0)
        WorkingRecords->MoveFirst();
    // The folder itself comes first: a dead medium must not be asked from here. What the workers
    // stand on is theirs: it never changes, and outlives this routine.
    const auto look = [folder, rows = WorkingRecords->rows(),
                       files = std::make_shared<const std::vector<FileMemory>>(mFiles)](
                          qsizetype number, const std::stop_token &) {
        if (number == 0)
            return FileFound{{DirExists(folder) ? FileMemory::Read : FileMemory::Missing}};
        const qsizetype row = number - 1;
        return lookAtFile(folder, rows->text(row, nameColumn), (*files)[std::size_t(row)]);
    };
    qsizetype next = 0;
    const auto takeOver = [&](qsizetype number, FileFound &&found) {
        if (number == 0) {
            reading.folderExists = found.memory.state == FileMemory::Read;
            return;
        }
        take(next++, std::move(found), reading);
        WorkingRecords->MoveNext();
    };
    const bool whole = work.eachOf<FileFound>(count() + 1, look, takeOver);
    reading.cancelled = !whole;
    for (; !whole && next < count(); ++next, WorkingRecords->MoveNext()) {
        if (mFiles[std::size_t(next)].state == FileMemory::Unread)
            take(next, {{FileMemory::Left, {}}, true, {}}, reading);
    }
    return reading;
}

void CollectionRows::take(qsizetype row, FileFound &&found, Reading &reading)
{
    if (found.memory.state == FileMemory::Missing)
        reading.allExist = false;
    if (!found.isNew)
        return;
    if (found.memory.state == FileMemory::Unreadable)
        reading.unreadable.append(fileName(row));
    writeTexts(row, found);
}

void CollectionRows::writeTexts(qsizetype row, const FileFound &found)
{
    mFiles[std::size_t(row)] = found.memory;
    const bool missing = found.memory.state == FileMemory::Missing;
    write(CollectionField::DoesFileExist, missing ? u"n"_s : u"y"_s);
    for (const auto &[column, field] : tagColumns)
        write(column, missing ? u"?"_s : found.tag.field(field));
}

void CollectionRows::write(CollectionField field, const QString &text)
{
    WorkingRecords->Fields(int(field)).setValue(text);
}

void CollectionRows::readAnew()
{
    for (FileMemory &file : mFiles) {
        if (file.state == FileMemory::Left)
            file = {};
    }
}
