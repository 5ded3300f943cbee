#pragma once

#include <functional>

/// Lets windows be painted until something has come or so many milliseconds have gone. What the
/// user does waits.
void paintUntil(const std::function<bool()> &come, int longest);

/// Has windows painted that need it, inside a call of a library that must not be entered again:
/// neither the user nor a timer nor the network comes in.
void paintAlone();
