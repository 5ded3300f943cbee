#pragma once

#include <QPointer>
#include <QWidget>
#include <optional>

class QPushButton;

/// What every screen is: a widget with a name, a load, an unload that may be refused, and default
/// (Enter) and cancel (Esc) buttons of its own. It stands in the frame, or by itself, or modal; it
/// is deleted when it has been unloaded and no routine waits any more: a routine of a form may open
/// a box or handle events without asking afterwards whether it still lives. That the form has been
/// unloaded meanwhile it must be ready for.
///
/// Order of life: constructor (controls, texts), Show() or ShowModal() (Form_Load once, then on the
/// screen), Form_Activate at each activation, Unload() (QueryUnload, then Form_Unload, then gone).
class Form : public QWidget
{
    Q_OBJECT

public:
    explicit Form(const QString &name);
    ~Form() override;

    QString Name() const { return objectName(); }

    /// Runs Form_Load if it has not run yet; the form stays hidden. One that unloads itself there
    /// is not shown.
    void Load();
    void Show(); // modeless; brings it up if it is shown already
    void ShowModal();

    /// False if the form refuses, as a busy one does.
    bool Unload();

    /// The same for several: all are asked, and only when all agree does one go. `Forced` ones are
    /// not asked.
    static bool UnloadAll(const QString &except, bool forced = false);

    /// Whether the form is in the middle of something that lets events through.
    bool isBusy() const { return mWorks > 0; }
    static Form *busyForm(); // nullptr if none is

    /// Makes a form busy for as long as it lives.
    class Busy
    {
    public:
        explicit Busy(Form &form) : mForm(&form) { ++form.mWorks; }
        ~Busy();
        Busy(const Busy &) = delete;
        Busy &operator=(const Busy &) = delete;

    private:
        QPointer<Form> mForm;
    };
    bool isUnloaded() const { return mUnloaded; }

    /// Where the form wants to stand, from the corner of its host; to be set in its load.
    void setPlace(QPoint corner) { mPlace = corner; }
    std::optional<QPoint> place() const { return mPlace; }

    /// All loaded forms, in the order in which they were made.
    static const QList<Form *> &openForms();

    /// Hosts modeless forms, as the frame does; without one they are windows of their own.
    class Host
    {
    public:
        virtual ~Host() = default;
        virtual void adopt(Form *form) = 0;   // puts it into the frame and shows it
        virtual void bringUp(Form *form) = 0; // to the front, with the focus
        virtual QPoint origin() const = 0;    // of the places of forms, on the screen
    };
    static void setHost(Host *host);

signals:
    void unloaded();
    void hid(); // by the program, an unload included
    void activated();

protected:
    virtual void Form_Load() {}
    virtual void Form_Activate() {}
    virtual bool QueryUnload() { return true; } // false: the form stays
    virtual void Form_Unload() {}

    /// Unloads and loads the form again on the spot: QueryUnload, Form_Unload, Form_Load. The
    /// object lives on with what it keeps in its members, and with its place on the screen; the
    /// focus goes and comes back. False if the form refuses or its load has unloaded it for good.
    bool Reload();

    void setDefaultButton(QPushButton *button); // Enter
    void setCancelButton(QPushButton *button);  // Esc
    void closeEvent(QCloseEvent *event) override;
    void hideEvent(QHideEvent *event) override;
    void keyPressEvent(QKeyEvent *event) override;

private:
    friend class FormActivation;
    bool agreesToGo() { return !isBusy() && QueryUnload(); }
    void finishUnload();

    QPointer<QPushButton> mDefault, mCancel;
    std::optional<QPoint> mPlace;
    int mWorks = 0;
    bool mLoaded = false, mUnloaded = false;
};

/// The single default instance of a screen: made when it is first asked for, and again after it was
/// unloaded.
template <typename Screen> Screen &defaultInstance()
{
    static QPointer<Screen> instance;
    if (!instance || instance->isUnloaded())
        instance = new Screen;
    return *instance;
}
