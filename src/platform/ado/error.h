#pragma once

#include <QString>
#include <exception>

namespace ADODB
{

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
    QString numbered() const
    {
        return QString::number(Number) + QStringLiteral(" - ") + Description;
    }

    const char *what() const noexcept override;

    int Number;
    QString Source;
    QString Description;

private:
    mutable QByteArray mWhat;
};

/// Failures that do not come from the database engine.
enum ErrorNumber : int {
    errOverflow = 6,
    errTypeMismatch = 13,
    errItemNotFound = 3265,
    errNoCurrentRecord = 3021,
    errObjectClosed = 3704,
    errNotPermitted = 3219,
    errSyntax = -2147217900,
    errConstraint = -2147217873,
    errReadOnly = -2147217911,
    errCannotUse = -2147467259,
};

/// Language of the descriptions of all later errors: 19 Dutch, any other English.
void setErrorLanguage(int language);

/// An error of this number with its description in the set language. Detail is put behind it.
Error makeError(ErrorNumber number, const QString &detail = {});

/// The error for a result code of SQLite; message is the engine's own, in English.
Error engineError(int code, const QString &message);

} // namespace ADODB
