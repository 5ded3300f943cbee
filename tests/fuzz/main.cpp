#include "fuzz/fuzz.h"
#include "platform/desktop/qtdesktop.h"
#include "support/texts.h"

#include <QCommandLineParser>
#include <QCoreApplication>
#include <QElapsedTimer>
#include <csignal>
#include <cstdio>
#include <unistd.h>

namespace
{

const char *gTarget = "";
unsigned gNumber = 0;

// Called where the program dies: only what is allowed there.
void tellWhere()
{
    char line[200];
    const int size =
        std::snprintf(line, sizeof line, "died with: --target %s --input %u\n", gTarget, gNumber);
    [[maybe_unused]] const auto written = write(STDERR_FILENO, line, std::size_t(size));
}

void onSignal(int number)
{
    tellWhere();
    signal(number, SIG_DFL);
    raise(number);
}

bool passes(const fuzz::Target &target, unsigned number)
{
    gTarget = target.name;
    gNumber = number;
    const QByteArray input = fuzz::inputOf(target, number);
    try {
        target.run(input);
        return true;
    } catch (const std::exception &failure) {
        std::fprintf(stderr, "%s\n%s\n", failure.what(), input.toPercentEncoding(" '(),=").data());
        tellWhere();
        return false;
    }
}

// Its inputs from the first on, for this long. Gives how many there were, 0 after a fault.
unsigned runFor(const fuzz::Target &target, qint64 milliseconds)
{
    QElapsedTimer clock;
    clock.start();
    unsigned number = 0;
    do {
        if (!passes(target, number))
            return 0;
        ++number;
    } while (clock.elapsed() < milliseconds);
    return number;
}

} // namespace

#if defined(__SANITIZE_ADDRESS__)
extern "C" void __sanitizer_set_death_callback(void (*callback)());
#endif

// songcase-fuzz [--seconds N] [--target NAME [--input NUMBER]]: the same inputs in the same order
// at each run; a fault is told with the two options that bring it back.
int main(int argc, char **argv)
{
    const QCoreApplication application(argc, argv);
    QtDesktop desktop; // for the time of day
    Desktop::setCurrent(&desktop);
    QCommandLineParser options;
    options.addOptions({{u"seconds"_s, u"For all targets."_s, u"N"_s, u"10"_s},
                        {u"target"_s, u"This one alone."_s, u"NAME"_s},
                        {u"input"_s, u"This input alone."_s, u"NUMBER"_s}});
    options.addHelpOption();
    options.process(application);
#if defined(__SANITIZE_ADDRESS__)
    __sanitizer_set_death_callback(tellWhere);
#else
    signal(SIGSEGV, onSignal);
#endif
    signal(SIGABRT, onSignal);

    // Most of the targets work on files; in memory, many times as many inputs are tried.
    if (const QByteArray memory = "/dev/shm"; access(memory.constData(), W_OK) == 0)
        qputenv("TMPDIR", memory);

    auto all = fuzz::targets();
    const QString one = options.value(u"target"_s);
    std::erase_if(all, [&](const fuzz::Target *t) {
        return !one.isEmpty() && one != QLatin1String(t->name);
    });
    bool good = !all.empty();
    for (const fuzz::Target *target : all) {
        if (options.isSet(u"input"_s)) {
            good &= passes(*target, options.value(u"input"_s).toUInt());
            continue;
        }
        const double seconds = options.value(u"seconds"_s).toDouble();
        const unsigned count = runFor(*target, qint64(seconds * 1000) / qint64(all.size()));
        std::printf("%-12s %8u inputs\n", target->name, count);
        good &= count > 0;
    }
    return good ? 0 : 1;
}
