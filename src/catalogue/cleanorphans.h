#pragma once

/// Removes the tracks, titles and artists to which nothing points any more, in one transaction. An
/// error is shown and goes no further; the transaction then stays open until the next one begins.
/// If the tables show that something did point at a row, the catalogue is damaged: then all is
/// taken back at once.
void CleanOrphans();
