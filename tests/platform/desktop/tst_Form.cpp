// Label: unit
#include "platform/desktop/drawingfreeze.h"
#include "platform/desktop/form.h"
#include "platform/desktop/qtdesktop.h"
#include "support/scripteddesktop.h"

#include <QLineEdit>
#include <QMessageBox>
#include <QPushButton>
#include <QTest>
#include <QTimer>
#include <QVBoxLayout>

/// The life of a screen, its two buttons, the freeze of drawing, and the desktop of a real session.
class tst_Form : public QObject
{
    Q_OBJECT

private slots:
    void init();
    void cleanup();
    void loadsOnceAndGoes();
    void refusesToClose();
    void reloadsOnTheSpot();
    void unloadsWhileLoading_data();
    void unloadsWhileLoading();
    void modalEndsWithUnloadOrHide_data();
    void modalEndsWithUnloadOrHide();
    void hostedOnesAreBroughtUp();
    void defaultInstanceAnew();
    void buttonsOfEnterAndEsc_data();
    void buttonsOfEnterAndEsc();
    void activation();
    void hourglassOutlivesItsWindow();
    void freezeEndsWithTheRoutine();
    void freezeStaysUnderAModalScreen();
    void freezesAreNotCounted();
    void questionOnlyItsButtonsAnswer_data();
    void questionOnlyItsButtonsAnswer();
    void boxesShowPlainText();
    void boxesWithoutATitle();
    void sentKeysFollowTheFocus();

private:
    std::unique_ptr<ScriptedDesktop> mDesktop;
};

namespace
{

class TestForm : public Form
{
    Q_OBJECT

public:
    TestForm() : Form(QStringLiteral("frmTest"))
    {
        auto *column = new QVBoxLayout(this);
        for (QWidget *w : std::initializer_list<QWidget *>{&text, &ok, &other, &cancel})
            column->addWidget(w);
        setDefaultButton(&ok);
        setCancelButton(&cancel);
        const auto note = [this](const QString &name) { return [this, name] { log += name; }; };
        connect(&ok, &QPushButton::clicked, this, note(QStringLiteral("ok ")));
        connect(&other, &QPushButton::clicked, this, note(QStringLiteral("other ")));
        connect(&cancel, &QPushButton::clicked, this, note(QStringLiteral("cancel ")));
        connect(this, &Form::unloaded, this, note(QStringLiteral("unloaded ")));
    }

    using Form::Reload;

    static inline QString log;
    bool stays = false, leavesAtLoad = false;
    QLineEdit text;
    QPushButton ok, other, cancel;

protected:
    void Form_Load() override
    {
        log += QStringLiteral("load ");
        if (leavesAtLoad)
            Unload();
    }
    void Form_Activate() override { log += QStringLiteral("activate "); }
    bool QueryUnload() override
    {
        log += QStringLiteral("query ");
        return !stays;
    }
    void Form_Unload() override { log += QStringLiteral("unload "); }
};

// Runs a piece of a test inside a main loop, as the program's own routines run.
template <typename Piece> void inMainLoop(Piece piece)
{
    QEventLoop loop;
    QTimer::singleShot(0, &loop, [&] {
        piece();
        loop.quit();
    });
    loop.exec();
}

} // namespace

void tst_Form::init()
{
    mDesktop = std::make_unique<ScriptedDesktop>();
    TestForm::log.clear();
}

void tst_Form::cleanup()
{
    mDesktop->verifyAllCame();
    const auto forms = Form::openForms();
    qDeleteAll(forms);
    QVERIFY(Form::openForms().isEmpty());
}

void tst_Form::loadsOnceAndGoes()
{
    QPointer<TestForm> form = new TestForm;
    QCOMPARE(Form::openForms(), QList<Form *>{form});
    form->Load();
    QVERIFY(!form->isVisible());
    form->Show();
    form->Show();
    QVERIFY(form->isVisible());
    QVERIFY(form->Unload());
    QVERIFY(form->Unload()); // gone already, and no second time
    QVERIFY(Form::openForms().isEmpty());
    QVERIFY(form && form->isUnloaded() && !form->isVisible());
    inMainLoop([] {});
    QTRY_VERIFY(!form);
    QVERIFY(TestForm::log.endsWith(QStringLiteral("query unload unloaded ")));
    QCOMPARE(TestForm::log.count(QStringLiteral("load ")), 2); // of "unload" too
}

void tst_Form::reloadsOnTheSpot()
{
    QPointer<TestForm> form = new TestForm;
    form->Show();
    form->activateWindow();
    QVERIFY(QTest::qWaitForWindowActive(form));
    form->text.setFocus();
    TestForm::log.clear();
    QVERIFY(form->Reload());
    QCOMPARE(TestForm::log, QStringLiteral("query unload load "));
    QVERIFY(form->isVisible() && !form->isUnloaded() && form->text.hasFocus());
    form->stays = true;
    QVERIFY(!form->Reload());
    QVERIFY(form->text.hasFocus());
    form->stays = false;
    form->leavesAtLoad = true;
    QVERIFY(!form->Reload());
    QVERIFY(form->isUnloaded());
}

void tst_Form::refusesToClose()
{
    auto *form = new TestForm;
    form->Show();
    form->stays = true;
    QVERIFY(!form->close());
    QVERIFY(form->isVisible() && !form->isUnloaded());
    form->stays = false;
    QVERIFY(form->close());
    QVERIFY(form->isUnloaded());
}

void tst_Form::unloadsWhileLoading_data()
{
    QTest::addColumn<bool>("modal");
    QTest::newRow("modeless") << false;
    QTest::newRow("modal") << true; // must not wait for an end that has been
}

void tst_Form::unloadsWhileLoading()
{
    QFETCH(bool, modal);
    auto *form = new TestForm;
    form->leavesAtLoad = true;
    modal ? form->ShowModal() : form->Show();
    QVERIFY(form->isUnloaded() && !form->isVisible());
}

void tst_Form::modalEndsWithUnloadOrHide_data()
{
    QTest::addColumn<bool>("scripted");
    QTest::addColumn<bool>("hides");
    QTest::newRow("real, unload") << false << false;
    QTest::newRow("real, hide") << false << true;
    QTest::newRow("scripted, unload") << true << false;
    QTest::newRow("scripted, hide") << true << true;
}

void tst_Form::modalEndsWithUnloadOrHide()
{
    QFETCH(bool, scripted);
    QFETCH(bool, hides);
    QtDesktop real;
    auto *form = new TestForm;
    const auto leave = [hides](Form &f) { hides ? f.hide() : void(f.Unload()); };
    if (scripted) {
        mDesktop->expectModal(QStringLiteral("frmTest"), leave);
    } else {
        Desktop::setCurrent(&real);
        QTimer::singleShot(0, form, [form, leave] { leave(*form); });
    }
    form->ShowModal();
    QVERIFY(!form->isVisible());
    QCOMPARE(form->isUnloaded(), !hides);
}

void tst_Form::hostedOnesAreBroughtUp()
{
    struct Host : Form::Host {
        void adopt(Form *form) override
        {
            TestForm::log += QStringLiteral("adopt ");
            form->show();
        }
        void bringUp(Form *) override { TestForm::log += QStringLiteral("up "); }
        QPoint origin() const override { return {100, 50}; }
    } host;
    Form::setHost(&host);
    TestForm form;
    form.Show();
    form.Show();
    QCOMPARE(TestForm::log.remove(QStringLiteral("activate ")), QStringLiteral("load adopt up "));
    auto *modal = new TestForm;
    modal->setPlace({10, 20});
    QPoint place;
    mDesktop->expectModal(QStringLiteral("frmTest"), [&](Form &f) {
        place = f.pos();
        f.Unload();
    });
    modal->ShowModal();
    Form::setHost(nullptr);
    QCOMPARE(place, QPoint(110, 70));
}

void tst_Form::defaultInstanceAnew()
{
    TestForm *first = &defaultInstance<TestForm>();
    QCOMPARE(&defaultInstance<TestForm>(), first);
    first->Unload();
    TestForm *second = &defaultInstance<TestForm>();
    QVERIFY(second != first && !second->isUnloaded());
    delete second;
    QVERIFY(!defaultInstance<TestForm>().isUnloaded());
}

void tst_Form::buttonsOfEnterAndEsc_data()
{
    QTest::addColumn<QString>("focus");
    QTest::addColumn<int>("key");
    QTest::addColumn<bool>("enabled");
    QTest::addColumn<QString>("clicked");
    const auto row = [](const char *name, const char *focus, Qt::Key key, bool enabled,
                        const char *clicked) {
        QTest::newRow(name) << QString::fromLatin1(focus) << int(key) << enabled
                            << QString::fromLatin1(clicked);
    };
    row("Enter in a field", "text", Qt::Key_Return, true, "ok ");
    row("the other Enter", "text", Qt::Key_Enter, true, "ok ");
    row("Esc in a field", "text", Qt::Key_Escape, true, "cancel ");
    row("Enter on another button", "other", Qt::Key_Return, true, "other ");
    row("Enter on the default button", "ok", Qt::Key_Return, true, "ok ");
    row("Esc on a button", "other", Qt::Key_Escape, true, "cancel ");
    row("Enter, disabled", "text", Qt::Key_Return, false, "");
    row("Esc, disabled", "text", Qt::Key_Escape, false, "");
    row("another key", "text", Qt::Key_A, true, "");
}

void tst_Form::buttonsOfEnterAndEsc()
{
    QFETCH(QString, focus);
    QFETCH(int, key);
    QFETCH(bool, enabled);
    TestForm form;
    form.ok.setEnabled(enabled);
    form.cancel.setEnabled(enabled);
    form.Show();
    QWidget *at = &form.text;
    if (focus != QLatin1String("text"))
        at = focus == QLatin1String("ok") ? &form.ok : &form.other;
    at->setFocus();
    TestForm::log.clear();
    QTest::keyClick(at, Qt::Key(key));
    QTEST(TestForm::log.remove(QStringLiteral("activate ")), "clicked");
}

void tst_Form::activation()
{
    TestForm one, other;
    for (TestForm *form : {&one, &other, &one}) {
        form->Show();
        form->activateWindow();
        form->text.setFocus();
        QTRY_COMPARE(QApplication::focusWidget(), &form->text);
        form->other.setFocus(); // within the form: not again
    }
    QCOMPARE(TestForm::log.count(QStringLiteral("activate ")), 3);
}

void tst_Form::hourglassOutlivesItsWindow()
{
    auto *window = new QWidget;
    {
        const Hourglass hourglass(window);
        QCOMPARE(window->cursor().shape(), Qt::WaitCursor);
        delete window;
    }
    QWidget other;
    {
        const Hourglass hourglass(&other);
    }
    QCOMPARE(other.cursor().shape(), Qt::ArrowCursor);
}

void tst_Form::freezeEndsWithTheRoutine()
{
    QWidget window;
    bool afterPump = true;
    inMainLoop([&] {
        Desktop::current().freeze(&window); // and an error: nobody releases it
        for (int i = 0; i < 5; ++i)
            Desktop::current().pump();
        afterPump = window.updatesEnabled();
    });
    QVERIFY(!afterPump);
    inMainLoop([] {});
    QTRY_VERIFY(window.updatesEnabled());
}

void tst_Form::freezeStaysUnderAModalScreen()
{
    QWidget window;
    bool during = true, after = true;
    inMainLoop([&] {
        const Freeze freeze(&window);
        QEventLoop modal;
        QTimer::singleShot(60, &modal, &QEventLoop::quit); // longer than the freeze looks away
        modal.exec();
        during = window.updatesEnabled();
    });
    after = window.updatesEnabled();
    QVERIFY(!during);
    QVERIFY(after);
}

void tst_Form::freezesAreNotCounted()
{
    QWidget one, other;
    {
        const Freeze outer(&one);
        {
            const Freeze inner(&other);
            QVERIFY(one.updatesEnabled() && !other.updatesEnabled());
        }
        QVERIFY(one.updatesEnabled() && other.updatesEnabled());
    }
    auto gone = std::make_unique<QWidget>();
    Desktop::current().freeze(gone.get());
    gone.reset();
    Desktop::current().freeze(nullptr);
}

void tst_Form::questionOnlyItsButtonsAnswer_data()
{
    QTest::addColumn<bool>("withCancel");
    QTest::addColumn<int>("answer");
    QTest::newRow("yes and no") << false << int(vbYes);
    QTest::newRow("with cancel") << true << int(vbCancel);
}

void tst_Form::questionOnlyItsButtonsAnswer()
{
    QFETCH(bool, withCancel);
    QtDesktop real;
    QTimer::singleShot(0, this, [] {
        auto *box = qobject_cast<QMessageBox *>(QApplication::activeModalWidget());
        QVERIFY(box);
        QTest::keyClick(box, Qt::Key_Escape);
        box->close();
        if (box->isVisible())
            QTest::keyClick(box, Qt::Key_Return); // Yes is the default
    });
    QTEST(int(real.messageBox(BoxKind::Question,
                              withCancel ? BoxButtons::YesNoCancel : BoxButtons::YesNo,
                              QStringLiteral("?"), QStringLiteral("t"))),
          "answer");
}

void tst_Form::boxesShowPlainText()
{
    QtDesktop real;
    QString text;
    auto format = Qt::AutoText;
    QTimer::singleShot(0, this, [&] {
        auto *box = qobject_cast<QMessageBox *>(QApplication::activeModalWidget());
        text = box->text();
        format = box->textFormat();
        box->accept();
    });
    real.messageBox(BoxKind::Error, BoxButtons::Ok, QStringLiteral("<b>\rnext"), QString());
    QCOMPARE(text, QStringLiteral("<b>\nnext"));
    QCOMPARE(format, Qt::PlainText);
}

void tst_Form::boxesWithoutATitle()
{
    setBoxTitle(QStringLiteral("The program"));
    mDesktop->expectBox(QStringLiteral("error [The program] a"));
    mDesktop->expectBox(QStringLiteral("information [b] a"));
    errorBox(QStringLiteral("a"));
    informationBox(QStringLiteral("a"), QStringLiteral("b"));
}

void tst_Form::sentKeysFollowTheFocus()
{
    TestForm form;
    form.Show();
    form.activateWindow();
    form.text.setFocus();
    QTRY_COMPARE(QApplication::focusWidget(), &form.text);
    Desktop::current().sendKeys(QStringLiteral("Tab, Tab"));
    QCOMPARE(QApplication::focusWidget(), &form.other);
    Desktop::current().sendKeys(QStringLiteral("Shift+Tab"));
    QCOMPARE(QApplication::focusWidget(), &form.ok);
}

QTEST_MAIN(tst_Form)
#include "tst_Form.moc"
