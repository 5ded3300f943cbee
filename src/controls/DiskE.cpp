#include "controls/DiskE.h"

DiskE::DiskE(QWidget *parent) : TrackGrid(Columns::WithoutArtist, parent) {}
