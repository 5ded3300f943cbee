#pragma once

#include "shell/MainScreen.h"
#include "support/scripteddesktop.h"
#include "support/texts.h"

#include <memory>

class QAction;

/// The whole program as a person runs it: the frame with its real menu, on the folder and settings
/// of the scripted desktop. The three seconds of the splash are not waited for.
class Program
{
public:
    explicit Program(ScriptedDesktop &desktop);
    ~Program();

    /// Load and the timer step. False if the program ended itself.
    bool start();

    /// Unloads the frame; false if a screen refused.
    bool end();

    /// Picks an entry of the menu. Fails the test if it is disabled.
    void choose(const char *entry);
    QAction *entry(const char *name) const;

    /// The open screen of this name, nothing if it is not open.
    Form *screen(const char *name) const;

    /// A control of a screen by its object name. Fails the test if it is not there.
    template <typename Control> Control *control(const char *screenName, const char *name) const
    {
        auto *found = screen(screenName)
                          ? screen(screenName)->findChild<Control *>(QLatin1String(name))
                          : nullptr;
        if (!found)
            missing(screenName, name);
        return found;
    }

    MainScreen &frame() { return *mFrame; }

private:
    void missing(const char *screenName, const char *name) const;

    ScriptedDesktop &mDesktop;
    std::unique_ptr<MainScreen> mFrame;
};

/// Sets the language that the next start will find.
void storeLanguage(int language);
