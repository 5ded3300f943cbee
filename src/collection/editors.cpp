#include "collection/editors.h"

#include "collection/browserlists.h"
#include "collection/frmCDRoot.h"
#include "collection/frmCDRootE.h"
#include "platform/desktop/desktop.h"
#include "platform/desktop/modalloop.h"
#include "services/messages.h"

using namespace Qt::StringLiterals;

namespace editors
{

namespace
{

template <typename Editor> CdEditor *open(const QString &mode, qint64 id)
{
    auto *editor = new Editor;
    editor->Mode = mode;
    editor->CdId = id;
    editor->Show();
    return editor;
}

template <typename Editor> Editor *find(qint64 id)
{
    for (Form *form : Form::openForms()) {
        auto *editor = qobject_cast<Editor *>(form);
        if (editor && editor->holds(id))
            return editor;
    }
    return nullptr;
}

template <typename Editor> CdEditor *edit(qint64 id)
{
    Editor *editor = find<Editor>(id);
    if (!editor)
        return open<Editor>(u"U"_s, id);
    editor->Show();
    return editor;
}

} // namespace

void newCompilation()
{
    open<frmCDRoot>(u"I"_s, 0);
}

void newAlbum()
{
    open<frmCDRootE>(u"I"_s, 0);
}

void editCompilation(qint64 id)
{
    edit<frmCDRoot>(id);
}

void editAlbum(qint64 id)
{
    edit<frmCDRootE>(id);
}

void editTrack(bool isCompilation, qint64 id, int disc, int track)
{
    CdEditor *editor = isCompilation ? edit<frmCDRoot>(id) : edit<frmCDRootE>(id);
    if (!editor->isUnloaded())
        editor->GoToTrack(disc, track);
}

void offerUnsaved()
{
    for (const RecoveryCopy::Found &found : RecoveryCopy::all()) {
        const UnsavedRecord &record = found.record;
        const QString name = record.header.title.trimmed();
        const QString question =
            name.isEmpty() ? GetMessage("xUnsavedUntitled")
                           : GetMessage("xUnsavedPart1") + name + GetMessage("xUnsavedPart2");
        if (askYesNo(question) != vbYes) {
            if (!modalWasRefused())
                RecoveryCopy::remove(found.file);
            continue;
        }
        // One that the catalogue has no longer as it was becomes a new record.
        HeldRecord held;
        held.know(record.id);
        const bool known = held.isStored() && held.content() == record.content;
        const QString mode = known ? u"U"_s : u"I"_s;
        CdEditor *editor =
            record.isAlbum ? open<frmCDRootE>(mode, record.id) : open<frmCDRoot>(mode, record.id);
        if (!editor->isUnloaded())
            editor->restore(record, found.file);
    }
}

void deleteRecord(qint64 id)
{
    const QPointer<CdEditor> editor = find<CdEditor>(id);
    if (editor)
        editor->keepForAnew();
    browserlists::deleteTitle(id);
    if (editor)
        editor->recordDeleted();
}

// One may go while the events of another are handled.
void saveAll()
{
    QList<QPointer<CdEditor>> open;
    for (Form *form : Form::openForms()) {
        if (auto *editor = qobject_cast<CdEditor *>(form))
            open.append(editor);
    }
    for (const auto &editor : open) {
        if (editor && !editor->isUnloaded())
            editor->SaveAtUserRequest();
        Desktop::current().pump();
    }
}

} // namespace editors
