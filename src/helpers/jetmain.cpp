#include "helpers/jet.h"

#include <csignal>
#include <cstdio>
#include <cstdlib>
#include <sys/prctl.h>

namespace
{

// Names of files are bytes, arguments pass through texts: "%41" is an A.
std::string unescaped(const std::string &argument)
{
    constexpr std::size_t digits = 2;
    std::string name;
    for (std::size_t i = 0; i < argument.size(); ++i) {
        if (argument[i] == '%') {
            name.push_back(char(std::strtol(argument.substr(i + 1, digits).c_str(), nullptr, 16)));
            i += digits;
        } else {
            name.push_back(argument[i]);
        }
    }
    return name;
}

} // namespace

int main(int count, char **arguments)
{
    if (count < 3) {
        std::fputs("songcase-jet FILE TABLE...\n", stderr);
        return int(jet::Result::Usage);
    }
    prctl(PR_SET_PDEATHSIG, SIGKILL); // a program that is gone cannot end what loops here
    return int(jet::printTables(unescaped(arguments[1]), {arguments + 2, arguments + count}));
}
