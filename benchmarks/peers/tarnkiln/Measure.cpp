#include "benchmarks/peers/tarnkiln/Measure.h"

#include <algorithm>
#include <cstdio>
#include <cstdlib>
#include <numeric>
#include <random>

#include <time.h>

namespace peers {
namespace {

constexpr std::size_t WARM_UP_ROUNDS = 1;
constexpr std::size_t ROUNDS = 3;
constexpr std::size_t MOST_ROUNDS = 101;
constexpr double NANOSECONDS = 100e6;

/// Runs so many rounds, or more if they are short.
std::vector<std::vector<double>> run(Measure::RoundOfSeveral const& round, std::size_t rounds,
                                     double nanoseconds)
{
    std::vector<std::vector<double>> figures;
    double spent = 0;
    while (figures.size() < rounds || (spent < nanoseconds && figures.size() < MOST_ROUNDS))
        spent += Measure::time([&] { figures.push_back(round()); });
    return figures;
}

void print(char const* side, char const* workload, double figure)
{
    std::printf("%s\t%s\t%.3f\n", side, workload, figure);
    std::fflush(stdout);
}

bool matches(std::string_view workload, std::string_view name)
{
    if (!name.ends_with('*'))
        return workload == name;
    name.remove_suffix(1);
    return workload.starts_with(name);
}
}  // namespace

Measure::Measure(std::size_t size, std::vector<std::string> wanted)
    : m_size(size),
      m_order(size),
      m_wanted(std::move(wanted))
{
    std::iota(m_order.begin(), m_order.end(), std::size_t{0});
    std::shuffle(m_order.begin(), m_order.end(), std::mt19937(1));
}

bool Measure::wants(std::string_view workload) const
{
    return m_wanted.empty() ||
           std::any_of(m_wanted.begin(), m_wanted.end(),
                       [&](std::string_view name) { return matches(workload, name); });
}

void Measure::ours(char const* workload, Round const& round) const
{
    ours({workload}, [&] { return std::vector<double>{round()}; });
}

void Measure::ours(std::vector<char const*> const& workloads, RoundOfSeveral const& round) const
{
    measure("ours", workloads, round);
}

void Measure::floor(char const* workload, Round const& round) const
{
    floor({workload}, [&] { return std::vector<double>{round()}; });
}

void Measure::floor(std::vector<char const*> const& workloads, RoundOfSeveral const& round) const
{
    measure("floor", workloads, round);
}

void Measure::oursOnce(char const* workload, Round const& round) const
{
    measureOnce("ours", workload, round);
}

void Measure::floorOnce(char const* workload, Round const& round) const
{
    measureOnce("floor", workload, round);
}

void Measure::measureOnce(char const* side, char const* workload, Round const& round) const
{
    if (wants(workload))
        print(side, workload, round());
}

double Measure::now()
{
    timespec passed{};
    clock_gettime(CLOCK_THREAD_CPUTIME_ID, &passed);
    return static_cast<double>(passed.tv_sec) * 1e9 + static_cast<double>(passed.tv_nsec);
}

void Measure::measure(char const* side, std::vector<char const*> const& workloads,
                      RoundOfSeveral const& round) const
{
    if (std::none_of(workloads.begin(), workloads.end(),
                     [&](char const* workload) { return wants(workload); }))
        return;
    run(round, WARM_UP_ROUNDS, 0);
    std::vector<std::vector<double>> const figures = run(round, ROUNDS, NANOSECONDS);
    for (std::size_t i = 0; i < workloads.size(); ++i)
    {
        std::vector<double> sorted;
        for (std::vector<double> const& of : figures)
            sorted.push_back(of[i]);
        std::sort(sorted.begin(), sorted.end());
        print(side, workloads[i], sorted[sorted.size() / 2]);
    }
}

void Measure::keep(long result)
{
    asm volatile("" : : "r"(result) : "memory");
}

void Measure::require(bool holds, char const* what)
{
    if (holds)
        return;
    std::fprintf(stderr, "expected: %s\n", what);
    std::exit(1);
}
}  // namespace peers
