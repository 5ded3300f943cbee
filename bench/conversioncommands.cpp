#include "conversion/frmAutoUpdateUtility.h"
#include "measure.h"
#include "opencatalogue.h"
#include "platform/error/error.h"
#include "services/globals.h"
#include "services/messages.h"
#include "workcommands.h"

#include <QLineEdit>
#include <QPlainTextEdit>
#include <QPushButton>

using namespace Qt::StringLiterals;

void convertOld(const QStringList &arguments)
{
    openForWork(arguments[0]);
    auto &screen = defaultInstance<frmAutoUpdateUtility>();
    screen.Load();
    screen.findChild<QLineEdit *>(u"txtOldDatabaseFileName"_s)->setText(arguments[1]);
    const auto log = [&] {
        return screen.findChild<QPlainTextEdit *>(u"ReportList"_s)->toPlainText();
    };
    measured("convert", [&] {
        screen.findChild<QPushButton *>(u"cmdStartConversion"_s)->click();
        return std::string(log().contains("Ready at "_L1) ? "converted " : "not converted ");
    });
    std::printf("%s", qUtf8Printable(log()));
    if (!log().contains("Ready at "_L1))
        throw Error(errCannotUse, {}, u"not converted"_s);
    screen.Unload();
}
