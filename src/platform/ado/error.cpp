#include "platform/ado/error.h"

#include <sqlite3.h>

namespace ADODB
{

namespace
{

int gErrorLanguage = 1;

struct Words {
    int code;
    ErrorNumber number;
    const char *english;
    const char *dutch;
};

constexpr Words engineWords[] = {
    {SQLITE_BUSY, errCannotUse, "The catalogue is in use by another program.",
     "De database is in gebruik bij een ander programma."},
    {SQLITE_LOCKED, errCannotUse, "The catalogue is in use by another program.",
     "De database is in gebruik bij een ander programma."},
    {SQLITE_FULL, errCannotUse, "The disk is full; nothing was written.",
     "De schijf is vol; er is niets weggeschreven."},
    {SQLITE_READONLY, errReadOnly, "The catalogue or its folder is read-only.",
     "De database of de map ervan is alleen-lezen."},
    {SQLITE_CANTOPEN, errCannotUse, "The catalogue or its folder cannot be opened.",
     "De database of de map ervan kan niet worden geopend."},
    {SQLITE_CORRUPT, errCannotUse, "The catalogue is damaged.", "De database is beschadigd."},
    {SQLITE_NOTADB, errCannotUse, "The file is not a catalogue of this program.",
     "Het bestand is geen database van dit programma."},
    {SQLITE_IOERR, errCannotUse, "The disk reported an error.", "De schijf meldt een fout."},
    {SQLITE_NOMEM, errCannotUse, "There is not enough memory.", "Er is niet genoeg geheugen."},
    {SQLITE_CONSTRAINT, errConstraint, "The catalogue refused the values.",
     "De database weigert de waarden."},
};

constexpr Words ownWords[] = {
    {0, errOverflow, "Overflow.", "Overloop."},
    {0, errTypeMismatch, "Type mismatch.", "Typen komen niet overeen."},
    {0, errItemNotFound, "The item is not in the collection.", "Het item komt niet voor."},
    {0, errNoCurrentRecord, "There is no current record.", "Er is geen huidige record."},
    {0, errObjectClosed, "The object is closed.", "Het object is gesloten."},
    {0, errNotPermitted, "The operation is not permitted here.",
     "De bewerking is hier niet toegestaan."},
    {0, errSyntax, "Syntax error in the statement.", "Syntaxisfout in de opdracht."},
    {0, errConstraint, "The catalogue refused the values.", "De database weigert de waarden."},
    {0, errReadOnly, "The catalogue or its folder is read-only.",
     "De database of de map ervan is alleen-lezen."},
    {0, errCannotUse, "The catalogue cannot be used.", "De database kan niet worden gebruikt."},
};

QString inLanguage(const Words &w)
{
    return QString::fromUtf8(gErrorLanguage == 19 ? w.dutch : w.english);
}

QString withDetail(const QString &text, const QString &detail)
{
    return detail.isEmpty() ? text : text + QStringLiteral(" (") + detail + QLatin1Char(')');
}

} // namespace

const char *Error::what() const noexcept
{
    mWhat = numbered().toUtf8();
    return mWhat.constData();
}

void setErrorLanguage(int language)
{
    gErrorLanguage = language;
}

Error makeError(ErrorNumber number, const QString &detail)
{
    for (const Words &w : ownWords) {
        if (w.number == number)
            return {number, QStringLiteral("ADODB"), withDetail(inLanguage(w), detail)};
    }
    return {number, QStringLiteral("ADODB"), detail};
}

Error engineError(int code, const QString &message)
{
    for (const Words &w : engineWords) {
        if (w.code == (code & 0xFF))
            return {w.number, QStringLiteral("SQLite"), withDetail(inLanguage(w), message)};
    }
    const Error syntax = makeError(errSyntax, message);
    return {syntax.Number, QStringLiteral("SQLite"), syntax.Description};
}

} // namespace ADODB
