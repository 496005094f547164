#include "Figures.h"

#include <algorithm>
#include <array>
#include <cstdio>
#include <fstream>
#include <iomanip>
#include <stdexcept>

namespace debian {

std::string inMilliseconds(std::chrono::duration<double> time)
{
    std::array<char, 32> text{};
    std::snprintf(text.data(), text.size(), "%.3f ms", time.count() * 1000);
    return text.data();
}

void Figures::addCount(std::string name, std::size_t count)
{
    m_rows.emplace_back(std::move(name), std::to_string(count));
}

void Figures::addTime(std::string name, std::chrono::duration<double> time)
{
    m_rows.emplace_back(std::move(name), inMilliseconds(time));
}

void Figures::print(std::ostream& output) const
{
    std::size_t nameWidth = 0;
    std::size_t valueWidth = 0;
    for (auto const& [name, value] : m_rows)
    {
        nameWidth = std::max(nameWidth, name.size());
        valueWidth = std::max(valueWidth, value.size());
    }
    for (auto const& [name, value] : m_rows)
        output << "  " << std::left << std::setw(static_cast<int>(nameWidth)) << name << "  "
               << std::right << std::setw(static_cast<int>(valueWidth)) << value << '\n';
}

void Figures::write(std::string const& file) const
{
    std::ofstream output(file, std::ios::binary);
    for (auto const& [name, value] : m_rows)
        output << name << '\t' << value << '\n';
    output.close();
    if (!output)
        throw std::runtime_error(file + ": cannot be written");
}

}  // namespace debian
