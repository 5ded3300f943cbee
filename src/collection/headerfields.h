#pragma once

#include <QPointer>
#include <QWidget>

class QComboBox;
class QKeyEvent;
class QLineEdit;

/// The head of a record as it stands in the fields. A compilation has no artist of its own: there
/// the text is always empty.
struct Header {
    QString artist, title, genre, year;
    friend bool operator==(const Header &, const Header &) = default;
};

/// The fields at the head of both editors: each selects its text when it gets the focus and hands
/// the keys that move between tracks and discs to the editor. The year is looked at when the user
/// leaves it by Tab or mouse; where the editor itself moves the focus on, by
/// Qt::ShortcutFocusReason, it is not.
class HeaderFields : public QObject
{
    Q_OBJECT

public:
    struct Fields {
        QLineEdit *artist; // nullptr on a compilation
        QLineEdit *title;
        QComboBox *genre;
        QLineEdit *year;
    };
    HeaderFields(const Fields &fields, QWidget *screen);

    Header shown() const; // as it is to be kept
    void show(const Header &header);

    /// Whether the year is one: four characters, numeric, above 1900. A box tells if it is not. An
    /// empty field is none either, but that is for the caller to judge, and no box comes.
    bool ValidateYear();

signals:
    void firstTrackWanted();
    void lastTrackWanted();
    void newDiscWanted();
    void discDeletionWanted();

protected:
    bool eventFilter(QObject *field, QEvent *event) override;

private:
    void watch(QWidget *field, QLineEdit *text);
    void setUpGenre();
    bool HandleFieldKey(QKeyEvent *event);
    void selectText(QObject *field, Qt::FocusReason reason);
    void left(QObject *field, Qt::FocusReason reason);
    void tellCut();
    void focusMoved(QWidget *from, QWidget *to);
    void leaveYear();

    Fields mFields;
    QWidget *mScreen;
    Header mBefore; // as last shown
    bool mYearLeftByHand = false;
    bool mTellsCut = false;
};
