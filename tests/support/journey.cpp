#include "support/journey.h"

#include "catalogue/cataloguefile.h"
#include "controls/list/DBListViewCTL.h"

void Journey::languages()
{
    const DataRows<int> row("language");
    row("English", languageEnglish);
    row("Dutch", languageDutch);
}

void Journey::start(int language)
{
    mDesktop = std::make_unique<ScriptedDesktop>();
    cataloguefile::create(mDesktop->folder + u"/Compact4.orv"_s);
    storeLanguage(language);
    mProgram = std::make_unique<Program>(*mDesktop);
    QVERIFY(mProgram->start());
    if (Form *help = mProgram->screen("frmHelp"))
        help->Unload();
    mProgram->frame().activateWindow();
    QVERIFY(QTest::qWaitForWindowActive(&mProgram->frame()));
    mProgram->choose("mnuUpdate");
}

void Journey::cleanup()
{
    if (mProgram)
        QVERIFY(mProgram->end());
    mProgram.reset();
    if (mDesktop)
        mDesktop->verifyAllCame();
    mDesktop.reset();
}

QStringList Journey::column(const char *name, int n) const
{
    auto *list = mProgram->control<DBListViewCTL>("frmCDList", name);
    QStringList found;
    for (int i = 1; i <= list->ListItems().Count(); ++i)
        found.append(list->ListItems().Item(i).SubItems(n));
    return found;
}
