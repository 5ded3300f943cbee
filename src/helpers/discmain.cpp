#include "helpers/disc.h"

#include <cdio/logging.h>
#include <cstdio>
#include <string_view>

namespace
{

disc::Result run(int count, char **arguments)
{
    const std::string_view what = count > 1 ? arguments[1] : "";
    if (what == "image" && count == 3)
        return disc::printImage(arguments[2]);
    if (what == "drive" && count == 3)
        return disc::printDrive(arguments[2]);
    if (what == "drives" && count == 2)
        return disc::printDrives();
    std::fputs("songcase-disc image FILE | drive DEVICE | drives\n", stderr);
    return disc::Result::Usage;
}

} // namespace

int main(int count, char **arguments)
{
    cdio_loglevel_default = CDIO_LOG_ERROR;
    return int(run(count, arguments));
}
