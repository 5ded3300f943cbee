#include "discdata/rippedfiles.h"

#include <QCollator>
#include <QSet>

namespace
{

constexpr size_t mostFiles = 999; // of a folder; more than that is no disc

void sortByNames(QStringList &names)
{
    QCollator order{QLocale(QLocale::English)}; // that of C knows no numbers
    order.setNumericMode(true);
    order.setCaseSensitivity(Qt::CaseInsensitive);
    std::ranges::sort(names, [&](const QString &a, const QString &b) { return order(a, b); });
}

} // namespace

std::vector<RippedFile> soundFilesIn(const QDir &folder,
                                     const std::function<bool(const QString &name)> &isWanted,
                                     const std::stop_token &stop, QString &unreadable)
{
    std::vector<RippedFile> files;
    QStringList names = folder.entryList(QDir::Files, QDir::Name);
    sortByNames(names);
    for (const QString &name : names) {
        if (stop.stop_requested() || files.size() > mostFiles)
            break;
        if (!isWanted(name))
            continue;
        const auto sound = readSoundFile(folder.filePath(name));
        if (!sound && unreadable.isEmpty())
            unreadable = folder.filePath(name);
        files.push_back({name, sound.value_or(SoundFile())});
    }
    return files;
}

bool haveNumbers(const std::vector<RippedFile> &files)
{
    QSet<int> numbers;
    for (const RippedFile &file : files)
        numbers.insert(file.sound.track);
    return !numbers.contains(0) && numbers.size() == qsizetype(files.size());
}

void sortByNumbers(std::vector<RippedFile> &files)
{
    std::ranges::sort(files, {}, [](const RippedFile &file) { return file.sound.track; });
}

std::optional<TableOfContents> tocOf(const std::vector<RippedFile> &files)
{
    std::vector<int> lengths;
    for (const RippedFile &file : files)
        lengths.push_back(file.sound.length);
    return tocOfLengths(lengths);
}
