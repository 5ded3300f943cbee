#pragma once

#include "controls/tracks/trackgrid.h"

/// The track grid of albums: the tracks belong to the artist of the title.
class DiskE : public TrackGrid
{
    Q_OBJECT

public:
    explicit DiskE(QWidget *parent = nullptr);
};
