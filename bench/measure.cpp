#include "measure.h"

#include <cstdio>
#include <ctime>
#include <fstream>
#ifdef __unix__
#include <sys/resource.h>
#endif

namespace
{

double userSeconds()
{
#ifdef __unix__
    rusage usage{};
    getrusage(RUSAGE_SELF, &usage);
    return double(usage.ru_utime.tv_sec) + double(usage.ru_utime.tv_usec) * 1e-6;
#else
    return double(std::clock()) / CLOCKS_PER_SEC;
#endif
}

} // namespace

Stopwatch::Stopwatch() : mStart(std::chrono::steady_clock::now()), mUser(userSeconds()) {}

double Stopwatch::wall() const
{
    return std::chrono::duration<double>(std::chrono::steady_clock::now() - mStart).count();
}

double Stopwatch::user() const
{
    return userSeconds() - mUser;
}

// Not from getrusage(): that counts the program that started this one as well.
long peakMemory()
{
    std::ifstream status("/proc/self/status");
    for (std::string word; status >> word;) {
        long kib = 0;
        if (word == "VmHWM:" && status >> kib)
            return kib;
    }
    return 0;
}

void measured(const char *name, const std::function<std::string()> &work)
{
    const Stopwatch watch;
    const std::string counts = work();
    std::printf("%s: %swall=%.4f user=%.4f\n", name, counts.c_str(), watch.wall(), watch.user());
}

std::string count(const char *name, long long value)
{
    return std::string(name) + '=' + std::to_string(value) + ' ';
}
