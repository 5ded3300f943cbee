#include "discs/partofset.h"

#include <QHash>
#include <QRegularExpression>

using namespace Qt::StringLiterals;

namespace
{

// Longer ones are no title; searching them would only take time.
constexpr qsizetype longestTitle = 1000, longestNotes = 4000;

const QHash<QString, int> &numberWords()
{
    static const QHash<QString, int> words{
        {u"one"_s, 1},  {u"two"_s, 2},  {u"three"_s, 3}, {u"four"_s, 4},   {u"five"_s, 5},
        {u"een"_s, 1},  {u"één"_s, 1},  {u"twee"_s, 2},  {u"drie"_s, 3},   {u"vier"_s, 4},
        {u"vijf"_s, 5}, {u"eins"_s, 1}, {u"zwei"_s, 2},  {u"drei"_s, 3},   {u"fünf"_s, 5},
        {u"un"_s, 1},   {u"deux"_s, 2}, {u"trois"_s, 3}, {u"quatre"_s, 4}, {u"cinq"_s, 5},
    };
    return words;
}

QString numberPattern()
{
    return u"(\\d{1,2}|"_s + numberWords().keys().join(u'|') + u")"_s;
}

QString remarkPattern()
{
    return u"(?:compact\\s?dis[ck]|dis[ck]|disque|cd|dvd|schijf|schijfje|plaat|scheibe|platte)"
           "\\s?(?:nr\\.?|no\\.?|n°|#|:|-)?\\s?"_s +
           numberPattern() + u"(?!\\w)"_s;
}

QString totalPattern()
{
    return u"(?:\\s?(?:out of|of|van(?: de)?|von|aus|sur|de|/)\\s?"_s + numberPattern() +
           u"(?!\\w))"_s;
}

QRegularExpression compiled(const QString &pattern)
{
    return QRegularExpression(pattern, QRegularExpression::CaseInsensitiveOption |
                                           QRegularExpression::UseUnicodePropertiesOption);
}

// A form that the remark may have: where number and total stand, and whether it says nothing else.
struct Form {
    QRegularExpression pattern;
    bool isAlone;
};

const std::vector<Form> &titleForms()
{
    static const QString remark = remarkPattern() + totalPattern() + u"?"_s;
    static const std::vector<Form> forms{
        {compiled(u"\\s?[(\\[{]\\s?"_s + remark + u"\\s?[)\\]}]"_s), true},
        {compiled(u"\\s?[(\\[{]\\s?"_s + numberPattern() + totalPattern() + u"\\s?[)\\]}]$"_s),
         true},
        {compiled(u"(?:\\s?[,;:/–—-])?\\s"_s + remark + u"$"_s), true},
        {compiled(u"[(\\[{]\\s?"_s + remark + u"\\s?[:,;–—-]"_s), false},
        {compiled(u"(?:^|[\\s,;:/–—-])"_s + remark + u"\\s?[:–—-]\\s"_s), false},
        {compiled(u"^"_s + remark + u"$"_s), false},
    };
    return forms;
}

const std::vector<Form> &notesForms()
{
    static const std::vector<Form> forms{
        {compiled(u"\\b"_s + remarkPattern() + totalPattern()), true},
        {compiled(u"^\\s?"_s + remarkPattern() + u"\\s?$"_s), true},
    };
    return forms;
}

int numberOf(const QString &text)
{
    return text.isEmpty() ? 0 : numberWords().value(text.toLower(), text.toInt());
}

// Fills the numbers; false where they cannot be.
bool take(const QRegularExpressionMatch &match, PartOfSet &part)
{
    const int number = numberOf(match.captured(1)), total = numberOf(match.captured(2));
    if (number < 1)
        return false;
    part.number = QString::number(number);
    part.total = QString::number(std::max(number, total));
    return true;
}

bool takeFrom(const QString &text, const std::vector<Form> &forms, PartOfSet &part,
              QString *rest = nullptr)
{
    for (const Form &form : forms) {
        const auto match = form.pattern.match(text);
        if (!match.hasMatch() || !take(match, part))
            continue;
        const QString without =
            QString(text.left(match.capturedStart()) + text.mid(match.capturedEnd())).trimmed();
        if (rest && form.isAlone && !without.isEmpty())
            *rest = without;
        return true;
    }
    return false;
}

} // namespace

PartOfSet partOfSet(const QString &title, const QString &notes)
{
    PartOfSet part;
    part.title = title;
    const bool isFound =
        title.size() <= longestTitle && takeFrom(title, titleForms(), part, &part.title);
    if (!isFound && !notes.isEmpty())
        takeFrom(notes.left(longestNotes), notesForms(), part);
    return part;
}
