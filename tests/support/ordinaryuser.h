#pragma once

#include <unistd.h>

/// Rights count for as long as this object lives: a test that runs as the super-user, whom they do
/// not stop, is nobody meanwhile. Folders in use must be open to all.
class OrdinaryUser
{
public:
    OrdinaryUser() : mWas(geteuid())
    {
        if (mWas == 0 && seteuid(65534) != 0)
            _exit(1);
    }
    ~OrdinaryUser()
    {
        if (seteuid(mWas) != 0)
            _exit(1);
    }
    OrdinaryUser(const OrdinaryUser &) = delete;
    OrdinaryUser &operator=(const OrdinaryUser &) = delete;

private:
    uid_t mWas;
};
