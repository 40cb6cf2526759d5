#pragma once

#include <chrono>
#include <cstddef>
#include <deque>
#include <string>

namespace gw {

/// The progress of a run.
struct RunProgress
{
    size_t done = 0;
    size_t total = 0;
    size_t failed = 0;
    double perSecond = 0.0; ///< recent rate; 0 if unknown
};

/// Returns "[=====>    ] 512/1000  48.2/s  10s left, 3 failed", cut to a width in characters.
std::string ProgressLine(const RunProgress& progress, size_t width);

/// A progress line on the terminal of standard error. Without a terminal, nothing is shown.
class CProgressBar
{
public:
    /// `total` is the number of jobs. Shows nothing unless `wanted`.
    CProgressBar(size_t total, bool wanted);
    ~CProgressBar() { Clear(); }
    CProgressBar(const CProgressBar&) = delete;
    CProgressBar& operator=(const CProgressBar&) = delete;

    /// Redraws the line if it is due.
    void Show(size_t done, size_t failed);
    /// Removes the line, so that other text can be written.
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
    std::deque<Sample> m_kSamples; ///< of the last seconds, oldest first
};

} // namespace gw
