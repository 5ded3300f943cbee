#pragma once

#include <chrono>
#include <functional>
#include <string>

/// Seconds since it was made: of the clock on the wall, and of the processor in user mode.
class Stopwatch
{
public:
    Stopwatch();
    double wall() const;
    double user() const;

private:
    std::chrono::steady_clock::time_point mStart;
    double mUser;
};

/// The most memory that this process has had, in KiB; 0 where the system does not tell.
long peakMemory();

/// Does the work and prints its name with what it gives back (counts as "name=1 name=2") and the
/// seconds that it took.
void measured(const char *name, const std::function<std::string()> &work);

/// A count as measured() prints it, with a blank behind.
std::string count(const char *name, long long value);
