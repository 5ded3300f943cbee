#pragma once

#include "collection/cdeditor.h"
#include "controls/tracks/trackgrid.h"
#include "services/globals.h"
#include "services/messages.h"
#include "support/countingbrowser.h"
#include "support/datarows.h"
#include "support/scripteddesktop.h"
#include "support/testcatalogue.h"

#include <QAction>
#include <QComboBox>
#include <QLineEdit>
#include <QTabBar>
#include <QToolBar>
#include <memory>

/// A person at the keyboard: keys go to whatever has the focus.
namespace keyboard
{

void press(Qt::Key key, Qt::KeyboardModifiers modifiers = Qt::NoModifier);
void type(const AnyText &text);

/// Texts with Tab behind each, the empty ones left as they are.
void fill(const QStringList &fields);

} // namespace keyboard

/// An editor of either kind on the screen, with a catalogue and a browser beside it.
class Editing
{
public:
    explicit Editing(int language);
    ~Editing();

    /// Shows an editor and waits until it is the active window.
    template <typename Editor> CdEditor *open(const AnyText &mode, qint64 id = 0)
    {
        auto *made = new Editor;
        made->Mode = mode;
        made->CdId = id;
        show(made);
        return editor;
    }
    void show(CdEditor *shown);

    template <typename Control> Control *control(const char *name) const
    {
        return editor->findChild<Control *>(QLatin1String(name));
    }
    QLineEdit *field(const char *name) const { return control<QLineEdit>(name); }
    QComboBox *genre() const { return control<QComboBox>("Genre"); }
    QTabBar *tabs() const { return control<QTabBar>("DiscsTab"); }
    TrackGrid *disk() const { return editor->findChild<TrackGrid *>(); }

    /// The nth button of TheDiskToolbar, from 1.
    QAction *button(int n) const
    {
        return control<QToolBar>("TheDiskToolbar")->actions().at(n - 1);
    }

    /// Puts tracks behind those of the disc that shows: a line each, its fields parted by "|".
    void addTracks(const QStringList &tracks);
    void setCell(int row, int column, const AnyText &text);
    QString cell(int row, int column) const;

    /// "disc/track artist - title" of the links of a title, in their order.
    QStringList tracks(qint64 id);

    ScriptedDesktop desktop;
    TestCatalogue catalogue;
    QPointer<CountingBrowser> browser;
    QPointer<CdEditor> editor;
};

/// "name mode id" of the editors that are open.
QStringList openEditors();
