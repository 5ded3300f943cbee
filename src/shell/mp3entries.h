#pragma once

class MainScreen;

/// The entry of the menu for a new collection of MP3 files.
void connectMP3Entries(MainScreen &frame);
