// Label: unit
#include "platform/desktop/drawingfreeze.h"
#include "platform/desktop/form.h"
#include "platform/desktop/modalloop.h"
#include "platform/desktop/nestedloop.h"
#include "platform/desktop/qtdesktop.h"
#include "support/datarows.h"
#include "support/scripteddesktop.h"

#include <QLineEdit>
#include <QMessageBox>
#include <QPushButton>
#include <QTimer>
#include <QVBoxLayout>

namespace
{

class TestForm : public Form
{
    Q_OBJECT

public:
    TestForm() : Form(u"frmTest"_s)
    {
        auto *column = new QVBoxLayout(this);
        for (QWidget *w : std::initializer_list<QWidget *>{&text, &ok, &other, &cancel})
            column->addWidget(w);
        setDefaultButton(&ok);
        setCancelButton(&cancel);
        const auto note = [this](const QString &name) { return [this, name] { log += name; }; };
        connect(&ok, &QPushButton::clicked, this, note(u"ok "_s));
        connect(&other, &QPushButton::clicked, this, note(u"other "_s));
        connect(&cancel, &QPushButton::clicked, this, note(u"cancel "_s));
        connect(this, &Form::unloaded, this, note(u"unloaded "_s));
    }

    using Form::Reload;

    static inline QString log;
    bool stays = false, leavesAtLoad = false;
    QLineEdit text;
    QPushButton ok, other, cancel;

protected:
    void Form_Load() override
    {
        log += u"load "_s;
        if (leavesAtLoad)
            Unload();
    }
    void Form_Activate() override { log += u"activate "_s; }
    bool QueryUnload() override
    {
        log += u"query "_s;
        return !stays;
    }
    void Form_Unload() override { log += u"unload "_s; }
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

/// The life of a screen, its two buttons, the freeze of drawing, and the desktop of a real session.
class tst_Form : public QObject
{
    Q_OBJECT

private:
    std::unique_ptr<ScriptedDesktop> mDesktop;

private slots:
    void init()
    {
        mDesktop = std::make_unique<ScriptedDesktop>();
        TestForm::log.clear();
    }

    void cleanup()
    {
        mDesktop->verifyAllCame();
        const auto forms = Form::openForms();
        qDeleteAll(forms);
        QVERIFY(Form::openForms().isEmpty());
    }

    void loadsOnceAndGoes()
    {
        QPointer<TestForm> form = new TestForm;
        QCOMPARE(Form::openForms(), QList<Form *>{form});
        form->Load();
        QVERIFY(!form->isVisible());
        form->Show();
        form->Show();
        form->stays = true;
        QVERIFY(!form->close() && form->isVisible() && !form->isUnloaded());
        form->stays = false;
        QVERIFY(form->Unload());
        QVERIFY(form->Unload()); // gone already, and no second time
        QVERIFY(Form::openForms().isEmpty());
        QVERIFY(form && form->isUnloaded() && !form->isVisible());
        inMainLoop([] {});
        QTRY_VERIFY(!form);
        QCOMPARE(TestForm::log.remove(u"activate "_s), u"load query query unload unloaded "_s);
    }

    void reloadsOnTheSpot()
    {
        QPointer<TestForm> form = new TestForm;
        form->Show();
        form->activateWindow();
        QVERIFY(QTest::qWaitForWindowActive(form));
        form->text.setFocus();
        TestForm::log.clear();
        QVERIFY(form->Reload());
        QCOMPARE(TestForm::log, u"query unload load "_s);
        QVERIFY(form->isVisible() && !form->isUnloaded() && form->text.hasFocus());
        form->stays = true;
        QVERIFY(!form->Reload());
        QVERIFY(form->text.hasFocus());
        form->stays = false;
        form->leavesAtLoad = true;
        QVERIFY(!form->Reload() && form->isUnloaded());
    }

    // A modal one must not wait for an end that has been.
    void unloadsWhileLoading()
    {
        for (const bool modal : {false, true}) {
            auto *form = new TestForm;
            form->leavesAtLoad = true;
            modal ? form->ShowModal() : form->Show();
            QVERIFY(form->isUnloaded() && !form->isVisible());
        }
    }

    void hostedOnesAreBroughtUp()
    {
        struct Host : Form::Host {
            void adopt(Form *form) override { form->show(); }
            void bringUp(Form *) override { TestForm::log += u"up "_s; }
            QPoint origin() const override { return {100, 50}; }
        } host;
        Form::setHost(&host);
        TestForm form;
        form.Show();
        form.Show();
        QCOMPARE(TestForm::log.remove(u"activate "_s), u"load up "_s);
        auto *modal = new TestForm;
        modal->setPlace({10, 20});
        QPoint place;
        mDesktop->expectModal(u"frmTest"_s, [&](Form &f) {
            place = f.pos();
            f.Unload();
        });
        modal->ShowModal();
        Form::setHost(nullptr);
        QCOMPARE(place, QPoint(110, 70));
    }

    void buttonsOfEnterAndEsc_data()
    {
        const DataRows<QString, int, bool, QString> row("focus", "key", "enabled", "clicked");
        row("Enter in a field", "text", Qt::Key_Return, true, "ok ");
        row("the other Enter", "text", Qt::Key_Enter, true, "ok ");
        row("Esc in a field", "text", Qt::Key_Escape, true, "cancel ");
        row("Enter on another button", "other", Qt::Key_Return, true, "other ");
        row("Enter on the default button", "ok", Qt::Key_Return, true, "ok ");
        row("Enter, disabled", "text", Qt::Key_Return, false, "");
        row("Esc, disabled", "text", Qt::Key_Escape, false, "");
    }

    void buttonsOfEnterAndEsc()
    {
        QFETCH(QString, focus);
        QFETCH(int, key);
        QFETCH(bool, enabled);
        TestForm form;
        form.ok.setEnabled(enabled);
        form.cancel.setEnabled(enabled);
        form.Show();
        const QMap<QString, QWidget *> fields{
            {u"text"_s, &form.text}, {u"ok"_s, &form.ok}, {u"other"_s, &form.other}};
        QWidget *at = fields[focus];
        at->setFocus();
        TestForm::log.clear();
        QTest::keyClick(at, Qt::Key(key));
        QTEST(TestForm::log.remove(u"activate "_s), "clicked");
    }

    void freezeEndsWithTheRoutine()
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

    void freezeStaysUnderAModalScreen()
    {
        QWidget window;
        bool during = true;
        inMainLoop([&] {
            const Freeze freeze(&window);
            const NestedLoop nested;
            QEventLoop modal;
            QTimer::singleShot(60, &modal, &QEventLoop::quit); // longer than the freeze looks away
            modal.exec();
            during = window.updatesEnabled();
        });
        QVERIFY(!during && window.updatesEnabled());
    }

    void freezesAreNotCounted()
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

    void questionOnlyItsButtonsAnswer()
    {
        QtDesktop real;
        QString text;
        const auto answer = [&](BoxButtons buttons) {
            inNextBox([&](QMessageBox &box) {
                QCOMPARE(box.textFormat(), Qt::PlainText);
                text = box.text();
                QTest::keyClick(&box, Qt::Key_Escape);
                box.close();
                if (box.isVisible())
                    QTest::keyClick(&box, Qt::Key_Return); // Yes is the default
            });
            return real.messageBox(BoxKind::Question, buttons, u"<b>\rnext"_s, u"t"_s);
        };
        QCOMPARE(answer(BoxButtons::YesNo), vbYes);
        QCOMPARE(answer(BoxButtons::YesNoCancel), vbCancel);
        QCOMPARE(text, u"<b>\nnext"_s);
    }

    void lettersTypedAheadAnswerNoBox_data()
    {
        const DataRows<QString, qint64, int> row("keys", "after", "answer");
        row("letter", "N", 699, vbYes);
        row("capital", "Shift+N", 0, vbYes);
        row("blank", "Space,Alt+N", 0, vbNo);
        row("at once", "Esc", 0, vbCancel);
        row("moved", "Right,Return", 0, vbNo);
        row("later", "N", 700, vbNo);
        row("later blank", "Space", 700, vbYes);
    }

    void lettersTypedAheadAnswerNoBox()
    {
        struct Clocked : QtDesktop {
            QDateTime now() override { return time; }
            QDateTime time{QDate(2026, 11, 22), QTime(12, 0)};
        } real;
        QFETCH(QString, keys);
        QFETCH(qint64, after);
        inNextBox([&](QMessageBox &box) {
            QVERIFY(QTest::qWaitForWindowActive(&box)); // Alt+letter goes to that alone
            real.time = real.time.addMSecs(after);
            const QKeySequence sequence(keys);
            for (uint i = 0; i < uint(sequence.count()); ++i) {
                const QKeyCombination key = sequence[i];
                QTest::keyClick(box.focusWidget(), key.key(), key.keyboardModifiers());
            }
            const auto buttons = box.buttons(); // a letter holds one down for a while
            if (box.isVisible() && std::none_of(buttons.begin(), buttons.end(),
                                                [](auto *button) { return button->isDown(); }))
                QTest::keyClick(&box, Qt::Key_Return);
            QTRY_VERIFY(!box.isVisible());
        });
        QTEST(int(real.messageBox(BoxKind::Question, BoxButtons::YesNoCancel, u"?"_s, u"t"_s)),
              "answer");
    }

    // A box is open over its form, and the form is unloaded below it.
    void nothingGoesUnderARoutineThatWaits()
    {
        QtDesktop real;
        QPointer<TestForm> form = new TestForm;
        form->Show();
        bool aliveBehindBox = false;
        inMainLoop([&] {
            QTimer::singleShot(0, form, [&] {
                QTimer::singleShot(60, qApp, [] { refuseModal(); }); // longer than it is looked at
                QVERIFY(form->Unload());
            });
            real.messageBox(BoxKind::Error, BoxButtons::Ok, u"wrong"_s, u"t"_s);
            aliveBehindBox = form;
        });
        QVERIFY(aliveBehindBox);
        QTRY_VERIFY(!form);
    }

    void allAreAskedBeforeOneGoes()
    {
        QPointer<TestForm> willing = new TestForm, refusing = new TestForm;
        refusing->stays = true;
        QVERIFY(!Form::UnloadAll({}));
        QCOMPARE(TestForm::log, u"query query "_s);
        refusing->stays = false;
        {
            const Form::Busy busy(*refusing);
            QVERIFY(!Form::UnloadAll({}));
        }
        TestForm::log.clear();
        QVERIFY(Form::UnloadAll({}));
        QCOMPARE(TestForm::log, u"query query unload unloaded unload unloaded "_s);
    }
};

QTEST_MAIN(tst_Form)
#include "tst_Form.moc"
