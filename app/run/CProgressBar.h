#pragma once

#include <chrono>
#include <cstddef>
#include <deque>
#include <string>

namespace gw {

/// How far a run is.
struct RunProgress
{
    size_t done = 0;
    size_t total = 0;
    size_t failed = 0;
    double perSecond = 0.0; ///< lately; 0 while nobody knows
};

/// "[=====>    ] 512/1000  48.2/s  10s left, 3 failed", cut to a width in characters.
std::string ProgressLine(const RunProgress& progress, size_t width);

/// A line on the terminal of standard error that shows how far a run is. Where standard error is none,
/// nothing is shown.
class CProgressBar
{
public:
    /// How many there are to do. Nothing is shown either unless it is wanted.
    CProgressBar(size_t total, bool wanted);
    ~CProgressBar() { Clear(); }
    CProgressBar(const CProgressBar&) = delete;
    CProgressBar& operator=(const CProgressBar&) = delete;

    /// Draws the line again, if that is due.
    void Show(size_t done, size_t failed);
    /// Takes the line off the terminal, so that other words can be written.
    void Clear();

private:
    using Clock = std::chrono::steady_clock;
    struct Sample
    {
        Clock::time_point time;
        size_t done = 0;
    };

    double Rate(const Sample& now);

    size_t m_uiTotal;
    bool m_bShown;
    bool m_bOnScreen = false;
    Clock::time_point m_kDue;
    std::deque<Sample> m_kSamples; ///< of the last seconds, the oldest first
};

} // namespace gw
