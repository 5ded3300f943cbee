#pragma once

class MainScreen;

/// The entry of the menu that takes back what the program has changed in files of the user.
void connectUndoEntry(MainScreen &frame);
