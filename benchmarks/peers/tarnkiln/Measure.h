/// \file
/// How workloads are measured: which are wanted, how often they run, and what is printed.
#pragma once
#include <cstddef>
#include <functional>
#include <string>
#include <string_view>
#include <vector>

namespace peers {

class Measure
{
public:
    /// The nanoseconds, or bytes, of one operation.
    using Round = std::function<double()>;
    /// The same of several workloads that are measured in one round.
    using RoundOfSeveral = std::function<std::vector<double>()>;

    /// \param wanted  names of workloads, where "*" at the end stands for anything; none for all.
    Measure(std::size_t size, std::vector<std::string> wanted);

    std::size_t size() const { return m_size; }
    /// The numbers of all books, shuffled.
    std::vector<std::size_t> const& order() const { return m_order; }
    bool wants(std::string_view workload) const;

    /// Prints the median of what `round` gives. Rounds run again if they are short.
    void ours(char const* workload, Round const& round) const;
    void ours(std::vector<char const*> const& workloads, RoundOfSeveral const& round) const;
    /// The same for what plain structs do.
    void floor(char const* workload, Round const& round) const;
    void floor(std::vector<char const*> const& workloads, RoundOfSeveral const& round) const;
    /// Prints a figure that is the same in each round.
    void oursOnce(char const* workload, Round const& round) const;
    void floorOnce(char const* workload, Round const& round) const;

    /// The nanoseconds of processor time that `body` takes.
    template <class Body> static double time(Body const& body);
    /// The same for each of the books, to which `body` does something each.
    template <class Body> double timeEach(Body const& body) const;
    /// Keeps the compiler from leaving out what leads to `result`.
    static void keep(long result);
    /// Ends the program if a workload did not do what it should.
    static void require(bool holds, char const* what);

private:
    static double now();
    void measureOnce(char const* side, char const* workload, Round const& round) const;
    void measure(char const* side, std::vector<char const*> const& workloads,
                 RoundOfSeveral const& round) const;

    std::size_t m_size;
    std::vector<std::size_t> m_order;
    std::vector<std::string> m_wanted;
};

template <class Body> double Measure::time(Body const& body)
{
    double const begin = now();
    body();
    return now() - begin;
}

template <class Body> double Measure::timeEach(Body const& body) const
{
    return time(body) / static_cast<double>(m_size);
}
}  // namespace peers
