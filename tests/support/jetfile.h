#pragma once

#include "support/texts.h"

#include <QVariant>
#include <vector>

/// A column of a table as the older program's database has it.
struct JetColumn {
    enum Type : quint8 { Bool = 1, Byte = 2, Int = 3, Long = 4, Double = 7, Text = 10, Memo = 12 };
    QByteArray name;
    Type type;
};

/// Rows hold a value for each column: an invalid one is NULL, a QByteArray the bytes of a text as
/// they are to stand in the file.
struct JetTable {
    QByteArray name;
    std::vector<JetColumn> columns;
    std::vector<QVariantList> rows;
    int statedRows = -1; // not those that are there
    std::vector<quint16> marks =
        {}; // of the first rows: 0xC000 deleted, 0x4000 was here, 0x8000 moved
};

struct JetHeader {
    int generation = 4; // 3 or 4
    quint32 key = 0;    // as if encrypted
    QByteArray password;
};

/// The smallest database with these tables: header, list of objects, pages of tables, of rows and
/// of memos, and the maps of all those. No indexes and no properties.
QByteArray jetFile(const std::vector<JetTable> &tables, const JetHeader &header = {});

/// The six tables of a catalogue, without a row.
std::vector<JetTable> emptyOldCatalogue();

/// A small one with two titles and what values may be like: letters beyond Latin, apostrophes, NULL
/// and the empty text.
std::vector<JetTable> oldCatalogue();
