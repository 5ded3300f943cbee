#pragma once

#include <QByteArray>

namespace ADODB
{
class Connection;
}

/// What a file holds beside what a new catalogue holds. They are compared by what the engine makes
/// of them, so that a file may have gone through another tool.
namespace schemacheck
{

/// Throws Error, with its name, if something of a new catalogue's tables is missing or differs, or
/// if anything is there that a new one does not have: a trigger, a view, a condition, a further
/// column. Nothing in the file has been run then. `creation` are the statements that make a new
/// one. Gives the statements that put right what may differ, indexes and statistics; empty if
/// nothing does.
QByteArray compare(ADODB::Connection &file, const QByteArray &creation);

} // namespace schemacheck
