#pragma once

#include <initializer_list>

class QWidget;

/// Which control shows the text of which key. Controls are named by their object names.
struct Caption {
    const char *control;
    const char *key;
    enum Where { Text, ToolTip } where = Text;
};

/// Sets the texts of a screen in one go. A control named like the screen itself is its window
/// title; a tool tip becomes the control's name for screen readers too.
void applyCaptions(QWidget *screen, std::initializer_list<Caption> captions);
