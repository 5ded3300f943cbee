#include "measure.h"
#include "platform/error/error.h"
#include "services/fileutilities.h"
#include "tags/filechanges.h"
#include "workcommands.h"

#include <QFileInfo>
#include <map>

using namespace Qt::StringLiterals;

namespace
{

TagField fieldNamed(const QString &name)
{
    const std::map<QString, TagField> names{{u"album"_s, TagField::Album},
                                            {u"title"_s, TagField::Title},
                                            {u"comments"_s, TagField::Comments},
                                            {u"artist"_s, TagField::LeadArtist},
                                            {u"track"_s, TagField::TrackPosition},
                                            {u"year"_s, TagField::Year},
                                            {u"genre"_s, TagField::Genre},
                                            {u"copyright"_s, TagField::CopyrightHolder},
                                            {u"label"_s, TagField::Label},
                                            {u"part"_s, TagField::PartOfSet},
                                            {u"id"_s, TagField::FileId}};
    const auto found = names.find(name);
    if (found == names.end())
        throw Error(errSyntax, {}, u"no such field: "_s + name);
    return found->second;
}

} // namespace

// As one command of the user, with the journal in the current folder.
void saveTag(const QStringList &arguments)
{
    const TagField field = fieldNamed(arguments[1]);
    const QStringList files = QFileInfo(arguments[0]).isDir()
                                  ? FindFilesInTree(arguments[0], u"*.mp3"_s, 1)
                                  : QStringList(arguments[0]);
    FileChanges::Tags tags;
    for (const QString &file : files) {
        CddbID3Tag tag;
        tag.LoadFromFile(file, 1);
        tag.setField(field, arguments[2]);
        tags.emplace_back(file, tag);
    }
    FileJournal journal(u"./Changes"_s);
    measured("open", [&] {
        journal.mend();
        return std::string();
    });
    measured("save", [&] {
        FileChanges changes(journal, {});
        changes.announce(tags);
        for (const auto &[file, tag] : tags)
            changes.saveTag(tag, file);
        return count("files", qint64(tags.size()));
    });
}
