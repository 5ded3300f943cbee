#include "cases.h"
#include "names.h"
#include "platform/text/collation.h"

namespace
{

std::vector<std::string> titles(bool accented)
{
    Names names(4);
    names.useOnly(accented);
    std::vector<std::string> titles;
    for (int i = 0; i < 10'000; ++i)
        titles.push_back(names.title());
    return titles;
}

void compare(benchmark::State &state, bool accented)
{
    const auto texts = titles(accented);
    const auto &order = text::Collation::root();
    std::size_t i = 0;
    for (auto _ : state) {
        const std::size_t next = i + 1 < texts.size() ? i + 1 : 0;
        benchmark::DoNotOptimize(order.compare(texts[i], texts[next]));
        i = next;
    }
}

// As a look-up that finds its row ends: both are the same but for case.
void compareEqual(benchmark::State &state, bool accented)
{
    const auto texts = titles(accented);
    const auto &order = text::Collation::root();
    std::size_t i = 0;
    for (auto _ : state) {
        benchmark::DoNotOptimize(order.compare(texts[i], texts[i]));
        i = i + 1 < texts.size() ? i + 1 : 0;
    }
}

void prefix(benchmark::State &state, bool accented)
{
    const auto texts = titles(accented);
    const auto &order = text::Collation::root();
    std::size_t i = 0;
    std::uint64_t number = 0;
    for (auto _ : state) {
        std::size_t at = 0;
        benchmark::DoNotOptimize(order.sortPrefix(texts[i], number, at));
        i = i + 1 < texts.size() ? i + 1 : 0;
    }
}

} // namespace

void registerTextRuleCases()
{
    for (const bool accented : {false, true}) {
        const std::string kind = accented ? "/accented" : "/ASCII";
        benchmark::RegisterBenchmark(("compare" + kind).c_str(), compare, accented);
        benchmark::RegisterBenchmark(("compare equal" + kind).c_str(), compareEqual, accented);
        benchmark::RegisterBenchmark(("sort prefix" + kind).c_str(), prefix, accented);
    }
}
