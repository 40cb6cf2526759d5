#include "Captions.h"

#include "Text.h"

#include <cmath>
#include <cstdio>

namespace gw {

namespace {

constexpr double kSameSpeed = 0.08; // a smaller difference is hardly visible

std::string Number(double value)
{
    char text[32];
    std::snprintf(text, sizeof(text), "%.4g", value);
    return text;
}

bool IsAbout(double value, double other)
{
    return std::fabs(value / other - 1.0) <= kSameSpeed;
}

// Returns how fast a motion plays compared with its own rate; empty if nobody would see the difference.
std::string SpeedWords(double speed)
{
    if (IsAbout(speed, 1.0))
        return {};
    if (IsAbout(speed, 0.5))
        return ", plays at half speed";
    if (IsAbout(speed, 2.0))
        return ", plays at double speed";
    if (speed < 1.0)
        return ", plays at " + std::to_string(std::lround(100.0 * speed)) + " % speed";
    return ", plays at " + Number(std::round(10.0 * speed) / 10.0) + " times its speed";
}

} // namespace

std::string MotionCaption(const std::string& name, const SourceTiming& timing, int clockMilliseconds)
{
    const double frames = std::floor(static_cast<double>(timing.lastFrame)) + 1.0;
    if (!(timing.frequency > 0.0f) || !(frames >= 1.0))
        return name;
    const double frameSeconds = static_cast<double>(timing.frequency);
    const double speed = frameSeconds * 1000.0 / clockMilliseconds;
    std::string caption = name + ": " + std::to_string(std::llround(frames));
    caption += frames == 1.0 ? " frame" : " frames at " + Number(1.0 / frameSeconds) + " fps";
    return frames == 1.0 ? caption : caption + SpeedWords(speed);
}

std::string ChoiceWords(const ConversionChoices& choices)
{
    std::string words = choices.align ? "aligned" : "";
    if (choices.faithful)
        words += words.empty() ? "faithful" : ", faithful";
    if (choices.faithful && !choices.holdHands)
        words += " (hands free)";
    return words;
}

std::string OriginCaption(const ResultOrigin& origin)
{
    const std::string options = ChoiceWords(origin.choices);
    return "Made with " + Quoted(origin.mapName) + (options.empty() ? "" : ", " + options) +
           (origin.plantsFeet ? "" : ", feet not planted");
}

} // namespace gw
