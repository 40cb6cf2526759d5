#include "BetterOptions.h"

#include "ConvertedMotion.h"
#include "KeyFigures.h"
#include "ShellOptions.h"
#include "Text.h"

#include <algorithm>
#include <cstdio>
#include <string_view>
#include <vector>

namespace gw {

namespace {

// Directions, feet and floor. For all of them, smaller is better.
constexpr std::string_view kKeys[] = {"directionError",   "footTurn",          "soleTilt",
                                      "ankleSlideMedian", "ankleSlideLargest", "toeSlideMedian",
                                      "toeSlideLargest",  "heldSole",          "sinking"};

std::vector<KeyFigure> FiguresOf(const MeasuredConversion& measured)
{
    return KeyFiguresOf(measured.sums, measured.detail);
}

bool IsFarOff(const KeyFigure& figure)
{
    return figure.verdict == EVerdict::Poor && std::ranges::find(kKeys, figure.key) != std::end(kKeys);
}

bool IsImproved(const KeyFigure& figure, const KeyFigure& other)
{
    constexpr double kLeast = 0.75; // a smaller gain is not worth another conversion
    return IsFarOff(figure) && other.value && *other.value < kLeast * *figure.value;
}

std::string Improvement(const KeyFigure& figure, const KeyFigure& other)
{
    char numbers[96];
    std::snprintf(numbers, sizeof numbers, " %.*f instead of %.*f", figure.decimals, *other.value,
                  figure.decimals, *figure.value);
    const std::string unit = figure.unit == "°" ? " deg" : std::string(figure.unit);
    return LowerCase(std::string(figure.label)) + numbers + unit;
}

} // namespace

bool MayBeBetter(const ShellOptions& options, const MeasuredConversion& measured)
{
    return !(options.align && options.faithful) && std::ranges::any_of(FiguresOf(measured), IsFarOff);
}

bool IsBetter(const MeasuredConversion& measured, const MeasuredConversion& better)
{
    const std::vector<KeyFigure> figures = FiguresOf(measured);
    const std::vector<KeyFigure> others = FiguresOf(better); // the same figures in the same order
    const auto isWorse = [](const KeyFigure& figure, const KeyFigure& other) {
        return !IsImproved(figure, other);
    };
    return !std::ranges::equal(figures, others, isWorse);
}

std::string BetterWords(const MeasuredConversion& measured, const MeasuredConversion& better)
{
    const std::vector<KeyFigure> figures = FiguresOf(measured);
    const std::vector<KeyFigure> others = FiguresOf(better);
    std::string words;
    for (size_t i = 0; i < figures.size(); ++i)
    {
        if (IsImproved(figures[i], others[i]))
            words += (words.empty() ? "" : ", ") + Improvement(figures[i], others[i]);
    }
    return "--align --faithful would give (measured): " + words;
}

} // namespace gw
