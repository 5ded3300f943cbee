#pragma once

#include <QStringList>

/// A row of a search result as a line of its export: each text between double quotes, with commas
/// between them. By design: a double quote inside a text stands as it is.
QString resultLine(const QStringList &texts);
