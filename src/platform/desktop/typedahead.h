#pragma once

class Desktop;
class QDialog;

/// What is still being typed into the field below does not answer a box that comes up: until it
/// has been seen for 700 ms of the desktop's clock, letters, digits, signs and blanks without Alt
/// or Ctrl are swallowed, and those of a key held down at any time. All other keys act at once. To
/// be called before the box is shown; the desktop must outlive it.
void ignoreTypedAhead(QDialog *box, Desktop &clock);
