#pragma once

#include "platform/ado/rows.h"

#include <QString>
#include <optional>

/// A collection in the catalogue: its head, and the writing of both. On gConnection; all throw
/// Error.
namespace collectionstore
{

struct Header {
    QString folder, title;
    friend bool operator==(const Header &a, const Header &b) = default;
};

/// Nothing if there is no such collection.
std::optional<Header> header(qint64 collection);

qint64 insertHeader(const Header &header); // gives the new id
void updateHeader(qint64 collection, const Header &header);

/// In place of those that the collection has: numbers and names of a CollectionRows.
void replaceFiles(qint64 collection, const ADODB::Rows &rows);

} // namespace collectionstore
