#pragma once

#include <QKeyEvent>

/// A key that the program itself sends to the control with the focus, as the button of a toolbar
/// does. All others are typed, also those that do not come from the window system: who listens to
/// the keys for a screen reader takes them and posts them again.
class SentKey : public QKeyEvent
{
public:
    using QKeyEvent::QKeyEvent;
    SentKey *clone() const override { return new SentKey(*this); }

    static bool is(const QKeyEvent &event) { return dynamic_cast<const SentKey *>(&event); }
};
