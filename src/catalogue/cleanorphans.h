#pragma once

/// Removes the tracks, titles and artists to which nothing points any more, in one transaction. An
/// error is shown and goes no further; the transaction then stays open until the next one begins.
void CleanOrphans();
