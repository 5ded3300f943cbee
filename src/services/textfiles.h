#pragma once

#include "platform/text/codepage.h"

#include <QByteArray>
#include <QString>
#include <memory>

class WholeFile;

/// A text file that is read line by line. Lines end at CR, CRLF or LF; a file that is valid UTF-8
/// is taken as such, any other as Windows-1252. The whole file is held in memory, so that counting
/// and reading see the same lines whatever happens to the file meanwhile.
class InputTextFile
{
public:
    bool atEnd() const { return mAt >= mContent.size(); }

    /// The number of lines from here to the end.
    int countLines() const;

private:
    friend bool OpenInputFile(const QString &name, InputTextFile &file);
    friend QString ReadTextLine(InputTextFile &file);
    friend bool CloseTextFile(InputTextFile &file);
    QByteArray mBytes;
    QByteArrayView mContent;
    qsizetype mAt = 0;
    text::Encoding mEncoding = text::Encoding::Utf8;
};

/// A text file that is written line by line, in UTF-8 with the line ends of the running system. It
/// takes its name when it is closed without an error, and not before: a file that is there already
/// is replaced whole or stays as it is.
class OutputTextFile
{
public:
    OutputTextFile();
    ~OutputTextFile();

    /// Why it could not be written, in the words of the system.
    QString reason() const;

private:
    friend bool OpenOutputFile(const QString &name, OutputTextFile &file);
    friend bool WriteTextLine(OutputTextFile &file, const QString &line);
    friend bool CloseTextFile(OutputTextFile &file);
    std::unique_ptr<WholeFile> mFile;
    QString mReason; // of one that is closed
};

/// False if the file cannot be opened; nothing is shown.
bool OpenInputFile(const QString &name, InputTextFile &file);
bool OpenOutputFile(const QString &name, OutputTextFile &file);

/// The next line without its end, the empty text behind the last.
QString ReadTextLine(InputTextFile &file);

/// False if the line could not be written.
bool WriteTextLine(OutputTextFile &file, const QString &line);

bool CloseTextFile(InputTextFile &file);  // always true
bool CloseTextFile(OutputTextFile &file); // false if the file did not get its name
