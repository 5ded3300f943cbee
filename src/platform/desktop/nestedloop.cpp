#include "platform/desktop/nestedloop.h"

namespace
{

int gDepth = 0;

} // namespace

NestedLoop::NestedLoop()
{
    ++gDepth;
}

NestedLoop::~NestedLoop()
{
    --gDepth;
}

bool NestedLoop::none()
{
    return gDepth == 0;
}
