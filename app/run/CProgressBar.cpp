// A progress line on a terminal. The rate is measured over the last seconds, so that the estimate follows a
// changing speed.

#include "CProgressBar.h"

#include "Terminal.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <cmath>
#include <cstdio>

namespace gw {

namespace {

using namespace std::chrono_literals;

constexpr auto kPeriod = 100ms;
constexpr auto kMemory = 15s; // long enough for a steady rate, short enough to follow changes
constexpr size_t kBarWidth = 24;

std::string OneDecimal(double value)
{
    char digits[32];
    return {digits, std::to_chars(digits, std::end(digits), value, std::chars_format::fixed, 1).ptr};
}

// "12s", "3m20s", "5h07m": at most two units.
std::string Duration(double seconds)
{
    const auto whole = std::llround(std::clamp(seconds, 0.0, 1e9));
    const std::array<long long, 3> part = {whole / 3600, whole / 60 % 60, whole % 60};
    const size_t first = part[0] ? 0 : part[1] ? 1 : 2;
    std::string text = std::to_string(part[first]) + "hms"[first];
    if (first < 2)
        text.append(part[first + 1] < 10 ? "0" : "").append(std::to_string(part[first + 1])) +=
            "hms"[first + 1];
    return text;
}

std::string Bar(size_t done, size_t total)
{
    const size_t filled = total ? std::min(done, total) * kBarWidth / total : kBarWidth;
    std::string bar(kBarWidth, ' ');
    std::fill_n(bar.begin(), filled, '=');
    if (filled < kBarWidth)
        bar[filled] = '>';
    return '[' + bar + ']';
}

void Write(const std::string& text)
{
    std::fwrite(text.data(), 1, text.size(), stderr);
}

} // namespace

std::string ProgressLine(const RunProgress& progress, size_t width)
{
    const size_t left = progress.total - std::min(progress.done, progress.total);
    std::string line = Bar(progress.done, progress.total) + ' ' + std::to_string(progress.done) + '/' +
                       std::to_string(progress.total);
    if (progress.perSecond > 0.0)
        line += "  " + OneDecimal(progress.perSecond) + "/s  " +
                Duration(static_cast<double>(left) / progress.perSecond) + " left";
    if (progress.failed > 0)
        line += ", " + std::to_string(progress.failed) + " failed";
    return line.substr(0, width);
}

CProgressBar::CProgressBar(size_t total, bool wanted)
    : m_uiTotal(total), m_bShown(wanted && IsTerminal(stderr))
{
}

void CProgressBar::Show(size_t done, size_t failed)
{
    const Clock::time_point now = Clock::now();
    if (!m_bShown || (m_bOnScreen && now < m_kDue))
        return;
    m_kDue = now + kPeriod;
    m_bOnScreen = true;
    // One column stays free, because a full line would wrap.
    const RunProgress progress{done, m_uiTotal, failed, Rate({now, done})};
    Write("\r\x1b[K" + ProgressLine(progress, TerminalWidth(stderr) - 1));
}

double CProgressBar::Rate(const Sample& now)
{
    m_kSamples.push_back(now);
    while (m_kSamples.size() > 2 && now.time - m_kSamples[1].time > kMemory)
        m_kSamples.pop_front();
    const Sample& then = m_kSamples.front();
    const double seconds = std::chrono::duration<double>(now.time - then.time).count();
    return seconds > 0.0 ? static_cast<double>(now.done - then.done) / seconds : 0.0;
}

void CProgressBar::Clear()
{
    if (m_bOnScreen)
        Write("\r\x1b[K");
    m_bOnScreen = false;
}

} // namespace gw
