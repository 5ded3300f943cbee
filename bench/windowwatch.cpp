#include <X11/Xlib.h>
#include <X11/Xutil.h>
#include <chrono>
#include <csignal>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <ctime>
#include <fstream>
#include <set>
#include <string>
#include <sys/wait.h>
#include <thread>
#include <unistd.h>

// window-watch [-t TITLE] PROGRAM [ARGUMENTS]: starts a program and tells when its window was
// mapped and when it was painted, seen from outside: the program needs no hook for it. With a title
// it waits for the window that has it; else for the first one, so that a splash counts. Ends the
// program. Wants an X server without a window manager: windows are sought below the root.

namespace
{

using Clock = std::chrono::steady_clock;
constexpr auto patience = std::chrono::seconds(30);
constexpr int leastWidth = 200, leastHeight = 100, leastColours = 3;

double since(Clock::time_point start)
{
    return std::chrono::duration<double, std::milli>(Clock::now() - start).count();
}

/// The windows on the windows.
class Windows
{
public:
    Windows() : mDisplay(XOpenDisplay(nullptr))
    {
        // Windows may go while they are looked at.
        XSetErrorHandler([](Display *, XErrorEvent *) { return 0; });
        if (mDisplay)
            forEach([this](Window window) { return mOld.insert(window), false; });
    }

    bool isThere() const { return mDisplay; }

    /// A new window that is mapped and large enough, 0 if there is none.
    Window mapped(const char *title)
    {
        return forEach([&](Window window) {
            XWindowAttributes a;
            return !mOld.count(window) && XGetWindowAttributes(mDisplay, window, &a) &&
                   a.map_state == IsViewable && a.width >= leastWidth && a.height >= leastHeight &&
                   (!title || hasTitle(window, title));
        });
    }

    bool painted(Window window)
    {
        XWindowAttributes a;
        if (!XGetWindowAttributes(mDisplay, window, &a))
            return false;
        XImage *image = XGetImage(mDisplay, window, 0, 0, unsigned(a.width), unsigned(a.height),
                                  AllPlanes, ZPixmap);
        if (!image)
            return false;
        std::set<unsigned long> colours;
        for (int y = 0; y < a.height && colours.size() < leastColours; y += 2) {
            for (int x = 0; x < a.width; x += 2)
                colours.insert(XGetPixel(image, x, y));
        }
        XDestroyImage(image);
        return colours.size() >= leastColours;
    }

private:
    template <typename Test> Window forEach(Test test)
    {
        Window root, parent, *children = nullptr, found = 0;
        unsigned count = 0;
        XQueryTree(mDisplay, DefaultRootWindow(mDisplay), &root, &parent, &children, &count);
        for (unsigned i = 0; i < count && !found; ++i)
            found = test(children[i]) ? children[i] : 0;
        XFree(children);
        return found;
    }

    bool hasTitle(Window window, const char *title)
    {
        XTextProperty name{};
        const bool same = XGetWMName(mDisplay, window, &name) && name.value &&
                          std::strcmp(reinterpret_cast<char *>(name.value), title) == 0;
        XFree(name.value);
        return same;
    }

    Display *mDisplay;
    std::set<Window> mOld;
};

double cpuOf(pid_t program)
{
    clockid_t clock;
    timespec t{};
    if (clock_getcpuclockid(program, &clock) == 0)
        clock_gettime(clock, &t);
    return double(t.tv_sec) * 1e3 + double(t.tv_nsec) / 1e6;
}

long peakOf(pid_t program)
{
    std::ifstream status("/proc/" + std::to_string(program) + "/status");
    long kib = 0;
    for (std::string word; status >> word;) {
        if (word == "VmHWM:" && status >> kib)
            break;
    }
    return kib;
}

pid_t start(char **command)
{
    const pid_t program = fork();
    if (program == 0) {
        execvp(command[0], command);
        _exit(127);
    }
    return program;
}

// False if the program ended or the patience did.
template <typename Test> bool waitFor(pid_t program, Test test)
{
    const auto begin = Clock::now();
    while (Clock::now() - begin < patience) {
        if (test())
            return true;
        if (waitpid(program, nullptr, WNOHANG) != 0)
            return false;
        std::this_thread::sleep_for(std::chrono::milliseconds(1));
    }
    return false;
}

} // namespace

int main(int argc, char **argv)
{
    const bool titled = argc > 3 && std::strcmp(argv[1], "-t") == 0;
    char **command = argv + (titled ? 3 : 1);
    Windows windows;
    if (!*command || !windows.isThere()) {
        std::fprintf(stderr, "window-watch [-t TITLE] PROGRAM [ARGUMENTS], with an X server\n");
        return 2;
    }
    const auto begin = Clock::now();
    const pid_t program = start(command);
    Window window = 0;
    const char *title = titled ? argv[2] : nullptr;
    bool there = waitFor(program, [&] { return (window = windows.mapped(title)) != 0; });
    const double mapped = since(begin);
    there = there && waitFor(program, [&] { return windows.painted(window); });
    const double painted = since(begin);
    if (!there) {
        std::fprintf(stderr, "no window\n");
        kill(program, SIGKILL);
        return 1;
    }
    std::printf("mapped_ms=%.1f painted_ms=%.1f cpu_ms=%.1f peak_kib=%ld\n", mapped, painted,
                cpuOf(program), peakOf(program));
    kill(program, SIGTERM);
    waitpid(program, nullptr, 0);
    return 0;
}
