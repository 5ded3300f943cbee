#pragma once

#include <QString>
#include <exception>

/// The one exception of the program: a number, where it comes from and what happened, in words for
/// the user. The layer that fails throws and never shows.
class Error : public std::exception
{
public:
    Error(int number, QString source, QString description)
        : Number(number), Source(std::move(source)), Description(std::move(description))
    {
    }

    /// "number - description", as the boxes show it.
    QString numbered() const;

    const char *what() const noexcept override;

    int Number;
    QString Source;
    QString Description;

private:
    mutable QByteArray mWhat;
};

/// Failures that do not come from the database engine, and those that its own are told as.
enum ErrorNumber : int {
    errOverflow = 6,
    errTypeMismatch = 13,
    errFileFailed = 57, // a file that is no catalogue cannot be read or written
    errItemNotFound = 3265,
    errNoCurrentRecord = 3021,
    errObjectClosed = 3704,
    errNotPermitted = 3219,
    errSyntax = -2147217900,
    errConstraint = -2147217873,
    errReadOnly = -2147217911,
    errCannotUse = -2147467259,
};

/// An error of this number with its description in the language of the run. Detail is put behind
/// it.
Error makeError(ErrorNumber number, const QString &detail = {});

/// The text of a key of the message table, with detail behind it.
QString errorText(const char *key, const QString &detail);
