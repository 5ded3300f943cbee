#pragma once

#include <Qt>

/// The key codes of the screens: 8 Backspace, 9 Tab, 13 Enter, 27 Esc, 32 blank, 33 and 34 page up
/// and down, 35 End, 36 Home, 37 to 40 left, up, right, down, 45 Insert, 46 Delete, 112 on F1 and
/// so forth; letters (capital) and digits are their Latin code. 0 for any
/// other key, signs among them.
int keyCodeOf(int qtKey);

/// 1 Shift, 2 Ctrl, 4 Alt.
int shiftStateOf(Qt::KeyboardModifiers modifiers);
