#pragma once

#include <functional>

/// Lets windows be painted until something has come or so many milliseconds have gone. What the
/// user does waits.
void paintUntil(const std::function<bool()> &come, int longest);
