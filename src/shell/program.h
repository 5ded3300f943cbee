#pragma once

/// The whole run of the program: sets the desktop up, loads the main screen and ends when that is
/// unloaded. Gives the exit code.
int runProgram(int argc, char **argv);
