#include "collection/editors.h"

#include "collection/frmCDRoot.h"
#include "collection/frmCDRootE.h"
#include "platform/desktop/desktop.h"

namespace editors
{

namespace
{

template <typename Editor> void open(const QString &mode, qint64 id)
{
    auto *editor = new Editor;
    editor->Mode = mode;
    editor->CdId = id;
    editor->Show();
}

// A new record may still carry the id of a save that was taken back; it is not that record.
template <typename Editor> Editor *find(qint64 id)
{
    for (Form *form : Form::openForms()) {
        auto *editor = qobject_cast<Editor *>(form);
        if (editor && editor->CdId == id && editor->Mode != QLatin1String("I"))
            return editor;
    }
    return nullptr;
}

template <typename Editor> void edit(qint64 id)
{
    if (Editor *editor = find<Editor>(id))
        editor->Show();
    else
        open<Editor>(QStringLiteral("U"), id);
}

} // namespace

void newCompilation()
{
    open<frmCDRoot>(QStringLiteral("I"), 0);
}

void newAlbum()
{
    open<frmCDRootE>(QStringLiteral("I"), 0);
}

void editCompilation(qint64 id)
{
    edit<frmCDRoot>(id);
}

void editAlbum(qint64 id)
{
    edit<frmCDRootE>(id);
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
