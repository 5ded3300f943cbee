#include "mp3/collections.h"

#include "mp3/frmCDRootMP3.h"

using namespace Qt::StringLiterals;

namespace collections
{

namespace
{

void show(const QString &mode, qint64 collection)
{
    auto *editor = new frmCDRootMP3;
    editor->Mode = mode;
    editor->CollectionId = collection;
    editor->Show();
}

frmCDRootMP3 *find(qint64 collection)
{
    for (Form *form : Form::openForms()) {
        auto *editor = qobject_cast<frmCDRootMP3 *>(form);
        if (editor && editor->holds(collection))
            return editor;
    }
    return nullptr;
}

} // namespace

void open()
{
    show(u"I"_s, 0);
}

void edit(qint64 collection)
{
    if (frmCDRootMP3 *editor = find(collection))
        editor->Show();
    else
        show(u"U"_s, collection);
}

void tellDeleted(qint64 collection)
{
    if (frmCDRootMP3 *editor = find(collection))
        editor->collectionDeleted();
}

} // namespace collections
