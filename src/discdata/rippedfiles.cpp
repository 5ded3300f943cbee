#include "discdata/rippedfiles.h"

#include "platform/files/nativename.h"

#include <QCollator>
#include <QSet>
#include <filesystem>

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

QStringList filesIn(const QString &folder)
{
    QStringList names;
    std::error_code error;
    const std::filesystem::path path = nativeName(folder).toStdString();
    for (std::filesystem::directory_iterator at(path, error), end; !error && at != end;
         at.increment(error)) {
        QString name = nameOfNative(QByteArray::fromStdString(at->path().filename().native()));
        if (std::error_code unknown; at->is_regular_file(unknown))
            names.append(std::move(name));
    }
    sortByNames(names);
    return names;
}

std::vector<RippedFile> soundFilesIn(const QString &folder,
                                     const std::function<bool(const QString &name)> &isWanted,
                                     const std::stop_token &stop, QString &unreadable)
{
    std::vector<RippedFile> files;
    for (const QString &name : filesIn(folder)) {
        if (stop.stop_requested() || files.size() > mostFiles)
            break;
        if (!isWanted(name))
            continue;
        const QString path = folder + u'/' + name;
        const auto sound = readSoundFile(path);
        if (!sound && unreadable.isEmpty())
            unreadable = path;
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
    lengths.reserve(files.size());
    for (const RippedFile &file : files)
        lengths.push_back(file.sound.length);
    return tocOfLengths(lengths);
}
