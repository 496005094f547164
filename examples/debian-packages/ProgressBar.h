/// \file
/// Shows on a terminal how far a long piece of work has come.
#pragma once
#include <chrono>
#include <cstdint>
#include <iosfwd>
#include <string>

namespace debian {

/// One line that is drawn over and over, and erased in the end.
///
/// Nothing is written unless the output is a terminal, and nothing during the first moments, so
/// that short work leaves no trace.
class ProgressBar
{
public:
    using Milliseconds = std::chrono::milliseconds;

    /// \param isTerminal  whether `output` is one.
    /// \param total  the number that stands for all of the work; 0 if it is not known.
    /// \param delay  how long work may take without a bar.
    ProgressBar(std::ostream& output, bool isTerminal, std::string label, std::uintmax_t total,
                Milliseconds delay = Milliseconds(500));
    ProgressBar(ProgressBar const&) = delete;
    ProgressBar& operator=(ProgressBar const&) = delete;
    ~ProgressBar();

    /// Draws the bar unless it was drawn a moment ago.
    void update(std::uintmax_t done);

private:
    using Clock = std::chrono::steady_clock;

    void draw(std::uintmax_t done);

    std::ostream& m_output;
    bool const m_isTerminal;
    std::string const m_label;
    std::uintmax_t const m_total;
    Clock::time_point m_nextDrawing;
    bool m_drawn = false;
};

}  // namespace debian
