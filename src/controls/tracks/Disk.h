#pragma once

#include "controls/tracks/trackgrid.h"

/// The track grid of compilations: each track has an artist of its own.
class Disk : public TrackGrid
{
    Q_OBJECT

public:
    explicit Disk(QWidget *parent = nullptr);
};
