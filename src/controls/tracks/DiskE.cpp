#include "controls/tracks/DiskE.h"

DiskE::DiskE(QWidget *parent) : TrackGrid(Columns::WithoutArtist, parent) {}
