#pragma once

#include <QByteArray>
#include <QString>
#include <stdexcept>
#include <utility>
#include <vector>

/// Broken input for the parts of the program that take bytes apart. A target brings a few good
/// inputs and a function that is given changed ones. A crash, or what must() does not find, is a
/// fault; an error that the part is allowed to throw is caught by the target itself.
///
/// A new target is a file of its own beside this one, with a Target in its anonymous namespace.
namespace fuzz
{

using Inputs = std::vector<QByteArray>;

struct Target {
    using Seeds = Inputs (*)();
    using Function = void (*)(const QByteArray &input);
    Target(const char *name, Seeds makeSeeds, Function run);

    const char *name;
    Seeds makeSeeds;
    Function run;
    Inputs seeds; // made when the targets are asked for
};

/// All of them, in the order of their names.
std::vector<Target *> targets();

/// The input of this number for a target: the same one at each call and in each run.
QByteArray inputOf(const Target &target, unsigned number);

/// What has to hold whatever the input.
inline void must(bool holds, const char *what)
{
    if (!holds)
        throw std::logic_error(what);
}

/// The input in two parts, for those that need two.
inline std::pair<QByteArray, QByteArray> halves(const QByteArray &input)
{
    const auto at = input.indexOf('|');
    return {input.left(at), at < 0 ? QByteArray() : input.mid(at + 1)};
}

} // namespace fuzz
