#include "consoledesktop.h"

#include <cstdio>

BoxAnswer ConsoleDesktop::messageBox(BoxKind kind, BoxButtons buttons, const QString &text,
                                     const QString &title)
{
    if (buttons != BoxButtons::Ok) {
        ++questions;
        return vbYes;
    }
    failed = failed || kind == BoxKind::Error || kind == BoxKind::Plain;
    std::fprintf(stderr, "[%s] %s\n", qUtf8Printable(title), qUtf8Printable(text));
    return vbOK;
}
