#pragma once

#include "collection/unsavedrecord.h"

#include <QString>

/// The copy of an editor's unsaved input beside the catalogue, for an end that nobody wanted: a
/// crash, a power cut. It is written whole, and gone once it is no longer needed. A disk that takes
/// none has no copy; the editor goes on.
class RecoveryCopy
{
public:
    void keep(const UnsavedRecord &record); // nothing is written if it says the same already
    void drop();

    /// The copy of an earlier run is this editor's from now on.
    void adopt(const QString &file) { mFile = file; }

    struct Found {
        QString file;
        UnsavedRecord record;
    };
    /// Those that earlier runs on this catalogue have left, oldest first.
    static QList<Found> all();
    static void remove(const QString &file);

private:
    static QString folder();

    QString mFile; // none yet: empty
    QByteArray mWritten;
};
