#include "shell/endsignals.h"

#include <QSocketNotifier>
#include <csignal>
#include <sys/socket.h>
#include <unistd.h>

namespace
{

int gPipe[2] = {-1, -1};

// Only what may be called inside a signal handler.
void tell(int)
{
    const char one = 1;
    [[maybe_unused]] const auto written = ::write(gPipe[0], &one, 1);
}

} // namespace

EndSignals::EndSignals()
{
    if (::socketpair(AF_UNIX, SOCK_STREAM, 0, gPipe) != 0)
        return;
    mNotifier = new QSocketNotifier(gPipe[1], QSocketNotifier::Read, this);
    connect(mNotifier, &QSocketNotifier::activated, this, [this] {
        char one;
        [[maybe_unused]] const auto got = ::read(gPipe[1], &one, 1);
        emit endRequested();
    });
    for (const int number : {SIGTERM, SIGINT, SIGHUP})
        std::signal(number, tell);
}

EndSignals::~EndSignals()
{
    for (const int number : {SIGTERM, SIGINT, SIGHUP})
        std::signal(number, SIG_DFL);
    ::close(gPipe[0]);
    ::close(gPipe[1]);
}
