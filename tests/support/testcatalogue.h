#pragma once

#include <QStringList>
#include <QTemporaryDir>

struct sqlite3;

/// An empty catalogue in a folder of its own, open as gConnection for as long as this object lives.
/// The other functions look at the file and change it through a second connection, as another
/// program would.
class TestCatalogue
{
public:
    TestCatalogue();
    ~TestCatalogue();

    QString file() const { return mFolder.filePath(QStringLiteral("Compact4.orv")); }
    QString path(const QString &name) const { return mFolder.filePath(name); }

    /// Runs statements, ";" between them. Fails the test if they fail.
    void exec(const QString &sql);

    /// The rows of a statement, values joined by "|"; NULL is "NULL".
    QStringList rows(const QString &sql);
    int count(const QString &sql); // the first value of the first row

private:
    QTemporaryDir mFolder;
};

/// A connection to this file with the attributes that the program gives its own, opened.
void openConnection(const QString &file);

/// A list of texts, given as UTF-8.
template <typename... Text> QStringList texts(Text... text)
{
    return {QString::fromUtf8(text)...};
}

/// A file with this content in a folder; gives its full name.
QString writeFile(const QString &name, const QByteArray &content);
