/// \file
/// The table of measurements at the end of a run.
#pragma once
#include <chrono>
#include <iosfwd>
#include <string>
#include <utility>
#include <vector>

namespace debian {

/// Measures the time since it was made.
class Stopwatch
{
public:
    std::chrono::duration<double> elapsed() const { return Clock::now() - m_begin; }

private:
    using Clock = std::chrono::steady_clock;

    Clock::time_point m_begin = Clock::now();
};

/// Such as "12.345 ms".
std::string inMilliseconds(std::chrono::duration<double> time);

/// Rows of a name and a measured value, printed in two columns.
class Figures
{
public:
    void addCount(std::string name, std::size_t count);
    void addTime(std::string name, std::chrono::duration<double> time);

    void print(std::ostream& output) const;
    /// Writes the rows for other programs, a line each, name and value parted by a tabulator.
    ///
    /// \throws std::runtime_error  if the file can not be written.
    void write(std::string const& file) const;

private:
    std::vector<std::pair<std::string, std::string>> m_rows;
};

}  // namespace debian
