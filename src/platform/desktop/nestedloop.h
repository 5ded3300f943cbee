#pragma once

/// Around everything that handles events inside a routine: a pump, a box, a modal screen, a wait.
/// What a routine of a screen stands on must not go before it has returned to the main event loop.
class NestedLoop
{
public:
    NestedLoop();
    ~NestedLoop();
    NestedLoop(const NestedLoop &) = delete;
    NestedLoop &operator=(const NestedLoop &) = delete;

    /// Whether no routine is waiting: what comes round now comes from the main event loop.
    static bool none();
};
