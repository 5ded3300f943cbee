#include "controls/tracks/Disk.h"

Disk::Disk(QWidget *parent) : TrackGrid(Columns::WithArtist, parent) {}
