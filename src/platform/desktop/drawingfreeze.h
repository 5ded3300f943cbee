#pragma once

class QWidget;

/// The one freeze of drawing: a window that shows no changes until it is released. It outlives a
/// pump of events but ends by itself when the routine that began it has returned to the main event
/// loop, so that no error can leave a dead window.
namespace drawingfreeze
{

void freeze(QWidget *window); // nullptr releases; freezes are not counted

} // namespace drawingfreeze
