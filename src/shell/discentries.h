#pragma once

class MainScreen;

/// The entries of menu and toolbar that look discs up and say how: look-up, sign-up, proxy,
/// credits.
void connectDiscEntries(MainScreen &frame);
