#pragma once

#include "support/texts.h"

#include <QTemporaryDir>
#include <functional>

struct sqlite3;

/// An empty catalogue in a folder of its own, open as gConnection for as long as this object lives.
/// The other functions look at the file and change it as another program would.
class TestCatalogue
{
public:
    TestCatalogue();
    ~TestCatalogue();

    QString file() const { return mFolder.filePath(u"Compact4.orv"_s); }
    QString path(const AnyText &name) const { return mFolder.filePath(name); }

    /// Runs statements, ";" between them. Fails the test if they fail.
    void exec(const AnyText &sql);

    /// The rows of a statement, values joined by "|"; NULL is "NULL".
    QStringList rows(const AnyText &sql);
    int count(const AnyText &sql); // the first value of the first row

private:
    QTemporaryDir mFolder;
};

/// Another program that has a catalogue open.
class OtherProgram
{
public:
    explicit OtherProgram(const QString &file);
    ~OtherProgram();
    int run(const QByteArray &sql) const; // gives the engine's own code
    sqlite3 *db = nullptr;
};

/// A connection to this file with the attributes that the program gives its own, opened.
void openConnection(const QString &file);

/// The number of the Error that a piece of code ends with, 0 if it does not.
int numberOf(const std::function<void()> &fails);

/// A file with this content in a folder; gives its full name.
QString writeFile(const QString &name, const QByteArray &content);

/// The bytes of a file, "none" if it cannot be read.
QByteArray readFile(const QString &name);
