#include "fuzz/fuzz.h"
#include "platform/text/collation.h"
#include "platform/text/likepattern.h"
#include "platform/text/textrules.h"
#include "services/textfiles.h"
#include "support/icuorder.h"
#include "support/referencelike.h"
#include "support/testcatalogue.h"

namespace
{

void runLike(const QByteArray &input)
{
    const auto [pattern, text] = fuzz::halves(input);
    const QString p = QString::fromUtf8(pattern), t = QString::fromUtf8(text);
    const bool fast = text::LikePattern(p.toStdString()).matches(t.toStdString());
    fuzz::must(fast == referenceLike(p, t), "LIKE differs from the slow way");
    text::LikePattern(pattern.toStdString()).matches(text.toStdString()); // broken UTF-8 as well
}

void runOrder(const QByteArray &input)
{
    static const IcuOrder icu;
    const auto [a, b] = fuzz::halves(input);
    const int right = icu.compare(a.toStdString(), b.toStdString());
    const int ours = text::Collation::root().compare(a.toStdString(), b.toStdString());
    fuzz::must((ours > 0) - (ours < 0) == right, "the order differs from the library's");
}

void runTextFile(const QByteArray &input)
{
    static const QTemporaryDir folder;
    InputTextFile file;
    const QString name = writeFile(folder.filePath(u"in.txt"_s), input);
    fuzz::must(OpenInputFile(name, file), "a text file is refused");
    const int lines = file.countLines();
    int read = 0;
    for (; !file.atEnd(); ++read) {
        const QString line = ReadTextLine(file);
        fuzz::must(!line.contains(u'\n') && !line.contains(u'\r'), "a line holds a line end");
        fuzz::must(text::properCase(line).size() == line.size(), "proper case changes a length");
        fuzz::must(text::cutTo(line, 5).size() <= 5, "cut too long");
        fuzz::must(!text::isNumeric(line) || line.contains(QRegularExpression(u"\\d"_s)),
                   "a number without a digit");
    }
    fuzz::must(read == lines, "lines counted and lines read differ");
}

fuzz::Target like(
    "like",
    [] {
        return fuzz::Inputs{"%bj\xC3\xB6rk%|BJ\xC3\x96RK", "a_c%e|abcde",      "%|x",
                            "_%_|\xF0\x9F\x8E\xB5",        "%ab%ab|xabyabzab", "\xCF\x83|\xCF\x82"};
    },
    runLike);

fuzz::Target order(
    "order",
    [] {
        return fuzz::Inputs{"Bj\xC3\xB6rk|bjork",
                            "Edith|\xC3\x89"
                            "dith",
                            "a\xCC\x81z|\xC3\xA1",
                            "10cc|10 cc!",
                            "L\xC2\xB7l|ll",
                            "\xE6\x97\xA5|Zz"};
    },
    runOrder);

fuzz::Target textFiles(
    "textfiles",
    [] {
        return fuzz::Inputs{"Title\r\n2\r\nArtist*Song*Pop*1985\r\n",
                            "\xEF\xBB\xBF"
                            "a\rb\nc",
                            "caf\xE9\n\x80\n", "\n\r\n\r"};
    },
    runTextFile);

} // namespace
