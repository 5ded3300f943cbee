#pragma once

#include "platform/desktop/form.h"

/// Says where the data of discs come from and under what terms.
class Credits : public Form
{
    Q_OBJECT

public:
    Credits();

protected:
    void Form_Load() override;
};
