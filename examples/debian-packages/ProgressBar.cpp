#include "ProgressBar.h"

#include <algorithm>
#include <ostream>
#include <utility>

namespace debian {
namespace {

constexpr std::uintmax_t WIDTH = 30;
constexpr ProgressBar::Milliseconds INTERVAL(100);
constexpr char const* ERASE_LINE = "\r\x1b[K";

}  // namespace

ProgressBar::ProgressBar(std::ostream& output, bool isTerminal, std::string label,
                         std::uintmax_t total, Milliseconds delay)
    : m_output(output),
      m_isTerminal(isTerminal),
      m_label(std::move(label)),
      m_total(total),
      m_nextDrawing(Clock::now() + delay)
{}

ProgressBar::~ProgressBar()
{
    if (m_drawn)
        m_output << ERASE_LINE << std::flush;
}

void ProgressBar::update(std::uintmax_t done)
{
    if (!m_isTerminal || Clock::now() < m_nextDrawing)
        return;
    draw(done);
    m_drawn = true;
    m_nextDrawing = Clock::now() + INTERVAL;
}

void ProgressBar::draw(std::uintmax_t done)
{
    m_output << ERASE_LINE << m_label << ' ';
    if (m_total == 0)
    {
        m_output << done / 1024 << " KiB" << std::flush;
        return;
    }
    std::uintmax_t const bounded = std::min(done, m_total);
    auto const full = static_cast<std::size_t>(bounded * WIDTH / m_total);
    m_output << '[' << std::string(full, '#') << std::string(WIDTH - full, ' ') << "] "
             << bounded * 100 / m_total << " %" << std::flush;
}

}  // namespace debian
