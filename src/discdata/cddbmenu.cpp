#include "discdata/cddbmenu.h"

#include "discdata/cddbcontrol.h"
#include "platform/desktop/desktop.h"

namespace
{

constexpr int registrationFlags = 4096;

// By design: behind a failure the session is not shut down; it ends with its object.
template <typename Command> void inSession(QWidget *owner, Command command)
{
    try {
        CDDBControl control;
        setUpCddb(control, owner);
        command(control);
        Desktop::current().pump();
        control.ShutDown();
    } catch (const Error &error) {
        showCddbError(error);
    }
}

} // namespace

void registerAtServices(QWidget *owner)
{
    inSession(owner, [](CDDBControl &control) {
        control.ShowRegistrationDialog(control.GetUserProfile(), registrationFlags);
    });
}

void showCredits(QWidget *owner)
{
    inSession(owner, [](CDDBControl &control) { control.ShowAboutBox(); });
}
