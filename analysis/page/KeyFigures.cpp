#include "KeyFigures.h"

#include "CMarkup.h"
#include "ConversionDetail.h"
#include "ConversionMeasures.h"
#include "Figures.h"
#include "Numbers.h"

#include <algorithm>
#include <cmath>
#include <iterator>

namespace gw {

namespace {

using Optional = std::optional<double>;

// What a figure is held against.
enum class EIdeal : uint8_t
{
    Least,   // the smaller the better
    Largest, // the larger the better
    Zero,    // the nearer to 0
    One,     // the nearer to 1
};

Optional DirectionError(const ConversionMeasures&, const ConversionDetail& detail)
{
    CRunningMean errors;
    for (const float error : detail.meanError)
        errors.Add(static_cast<double>(error));
    return errors.Count() > 0 ? Optional(errors.Mean()) : std::nullopt;
}

// The worse one of the feet.
template <auto Figure>
Optional OfFeet(const ConversionMeasures& measures, const ConversionDetail&)
{
    CRunningMean figures;
    for (const FootMeasures& foot : measures.feet)
        figures.Add(static_cast<double>(Figure(foot)));
    return figures.Count() > 0 ? Optional(figures.Largest()) : std::nullopt;
}

double TurnOf(const FootMeasures& foot)
{
    return foot.turnError;
}
double TiltOf(const FootMeasures& foot)
{
    return std::max(0.0, foot.soleTiltMean - foot.sourceSoleTiltMean);
}
double SlideOf(const FootMeasures& foot)
{
    return foot.addedSlideLargest;
}

Optional KneePops(const ConversionMeasures& measures, const ConversionDetail&)
{
    size_t pops = 0;
    for (const FootMeasures& foot : measures.feet)
        pops += foot.kneePops;
    return measures.feet.empty() ? std::nullopt : Optional(static_cast<double>(pops));
}

Optional SinkDepth(const ConversionMeasures& measures, const ConversionDetail&)
{
    return measures.feet.empty() ? std::nullopt : Optional(measures.sinkDepth);
}

template <Optional ConversionMeasures::*member>
Optional Of(const ConversionMeasures& measures, const ConversionDetail&)
{
    return measures.*member;
}

struct Row
{
    std::string_view key;
    std::string_view label;
    std::string_view unit;
    int decimals;
    EIdeal ideal;
    double good; // the last figure that is good
    double fair; // the last one that is fair
    Optional (*value)(const ConversionMeasures&, const ConversionDetail&);
};

constexpr Row kRows[] = {
    {"directionError", "Direction error", "°",  1, EIdeal::Least,   3.0,  5.0,  DirectionError                      },
    {"footTurn",       "Foot turn",       "°",  1, EIdeal::Least,   3.0,  10.0, OfFeet<TurnOf>                      },
    {"soleTilt",       "Sole tilt",       "°",  1, EIdeal::Least,   10.0, 20.0, OfFeet<TiltOf>                      },
    {"addedSlide",     "Added slide",     " mm", 1, EIdeal::Least,   5.0,  15.0, OfFeet<SlideOf>                     },
    {"contactF1",      "Contacts F1",     "",    3, EIdeal::Largest, 0.95, 0.9,  Of<&ConversionMeasures::contactF1>  },
    {"floor",          "Floor",           " mm", 1, EIdeal::Zero,    10.0, 30.0, Of<&ConversionMeasures::floorHeight>},
    {"sinking",        "Sinking",         " mm", 1, EIdeal::Least,   10.0, 30.0, SinkDepth                           },
    {"kneePops",       "Knee pops",       "",    0, EIdeal::Least,   0.0,  2.0,  KneePops                            },
    {"jitterRatio",    "Jitter ratio",    "",    2, EIdeal::Least,   1.1,  1.5,  Of<&ConversionMeasures::jitterRatio>},
    {"travelRatio",    "Travel ratio",    "",    3, EIdeal::One,     0.01, 0.05, Of<&ConversionMeasures::travelRatio>},
};

// How far a figure is from the ideal, so that less is better.
double Distance(EIdeal ideal, double value)
{
    switch (ideal)
    {
    case EIdeal::Largest:
        return -value;
    case EIdeal::Zero:
        return std::fabs(value);
    case EIdeal::One:
        return std::fabs(value - 1.0);
    default:
        return value;
    }
}

EVerdict VerdictOf(const Row& row, const Optional& value)
{
    const double sign = row.ideal == EIdeal::Largest ? -1.0 : 1.0;
    if (!value)
        return EVerdict::None;
    const double distance = Distance(row.ideal, *value);
    if (distance <= sign * row.good)
        return EVerdict::Good;
    return distance <= sign * row.fair ? EVerdict::Fair : EVerdict::Poor;
}

std::string Shortest(double value)
{
    std::string text;
    AppendFixed(text, value, value == std::floor(value) ? 0 : 2);
    return text;
}

std::string MarkOf(const Row& row)
{
    constexpr const char* kBefore[] = {"to ", "from ", "within ", "within "};
    const auto before = kBefore[static_cast<size_t>(row.ideal)];
    const std::string behind = std::string(row.unit) + (row.ideal == EIdeal::One ? " of 1" : "");
    return "good " + (before + Shortest(row.good)) + behind + ", fair " + before + Shortest(row.fair) +
           behind;
}

struct VerdictRow
{
    std::string_view word;
    std::string_view sign;
    std::string_view style;
};

constexpr VerdictRow kVerdicts[] = {
    {"Good", "✓", "good"},
    {"Fair", "▲", "fair"},
    {"Poor", "✕", "poor"},
    {"None", "–", "none"},
};

} // namespace

size_t KeyFigureCount()
{
    return std::size(kRows);
}

std::vector<KeyFigure> KeyFiguresOf(const ConversionMeasures& measures, const ConversionDetail& detail)
{
    std::vector<KeyFigure> figures;
    for (const Row& row : kRows)
    {
        const Optional value = row.value(measures, detail);
        figures.push_back(
            {row.key, row.label, row.unit, row.decimals, value, VerdictOf(row, value), MarkOf(row)});
    }
    return figures;
}

double BadnessOf(const std::vector<KeyFigure>& figures)
{
    constexpr double kPoor = 1e6;
    constexpr double kFair = 1e3; // above 180 degrees, the most that the first figure can be
    const auto poor = std::ranges::count(figures, EVerdict::Poor, &KeyFigure::verdict);
    const auto fair = std::ranges::count(figures, EVerdict::Fair, &KeyFigure::verdict);
    const double first = figures.empty() ? 0.0 : figures[0].value.value_or(0.0);
    return kPoor * static_cast<double>(poor) + kFair * static_cast<double>(fair) + first;
}

std::string_view VerdictWord(EVerdict verdict)
{
    return kVerdicts[static_cast<size_t>(verdict)].word;
}

std::string_view VerdictSign(EVerdict verdict)
{
    return kVerdicts[static_cast<size_t>(verdict)].sign;
}

std::string_view VerdictClass(EVerdict verdict)
{
    return kVerdicts[static_cast<size_t>(verdict)].style;
}

void AppendFigure(CMarkup& page, const KeyFigure& figure)
{
    if (figure.value)
        page.Number(*figure.value, figure.decimals).Raw("<i>").Raw(figure.unit).Raw("</i>");
    else
        page.Raw("none");
}

} // namespace gw
