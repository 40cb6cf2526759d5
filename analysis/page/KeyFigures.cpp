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

// The ideal value of a figure.
enum class EIdeal : uint8_t
{
    Least,   // smaller is better
    Largest, // larger is better
    Zero,    // closer to 0 is better
    One,     // closer to 1 is better
};

Optional DirectionError(const ConversionMeasures&, const ConversionDetail& detail)
{
    CRunningMean errors;
    for (const float error : detail.meanError)
        errors.Add(static_cast<double>(error));
    return errors.Count() > 0 ? Optional(errors.Mean()) : std::nullopt;
}

// Returns the worse of the two feet.
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

// Returns no value if no joint is ever planted.
template <SlideMeasures ConversionMeasures::*slide, double SlideMeasures::*figure>
Optional Slide(const ConversionMeasures& measures, const ConversionDetail&)
{
    return (measures.*slide).plants > 0 ? Optional(measures.*slide.*figure) : std::nullopt;
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

struct KeyRow
{
    std::string_view key;
    std::string_view label;
    std::string_view unit;
    int decimals;
    EIdeal ideal;
    double good; // limit of good figures
    double fair; // limit of fair figures
    Optional (*value)(const ConversionMeasures&, const ConversionDetail&);
    std::string_view meaning;
};

using Sums = ConversionMeasures;

// clang-format off
constexpr KeyRow kRows[] = {
    {"directionError", "Direction error", "°", 1, EIdeal::Least, 3.0, 5.0, DirectionError,
     "How far the main bones point away from the source's, as an angle: the mean over bones and frames."},
    {"trunkMean", "Trunk, mean", "°", 1, EIdeal::Least, 2.0, 4.0, Of<&Sums::trunkMean>,
     "How far the line from the middle of the hip joints to the neck leans away from the source's: the mean over the frames, without the difference that the two rest poses have."},
    {"trunkMost", "Trunk, 95 %", "°", 1, EIdeal::Least, 5.0, 10.0, Of<&Sums::trunkMost>,
     "The same angle, which one frame in twenty exceeds."},
    {"footTurn", "Foot turn", "°", 1, EIdeal::Least, 3.0, 10.0, OfFeet<TurnOf>,
     "How far the worse foot points to the left or right of the source's, seen from above: the mean over the frames."},
    {"soleTilt", "Sole tilt", "°", 1, EIdeal::Least, 10.0, 20.0, OfFeet<TiltOf>,
     "How much more the sole of the worse foot is tilted than the source's while it stands."},
    {"ankleSlideMedian", "Ankle slide, median", " mm", 1, EIdeal::Least, 3.0, 6.0, Slide<&Sums::ankleSlide, &SlideMeasures::median>,
     "How much farther a planted ankle slides over the floor than the source's: half of all plants are better."},
    {"ankleSlideLargest", "Ankle slide, worst", " mm", 1, EIdeal::Least, 15.0, 30.0, Slide<&Sums::ankleSlide, &SlideMeasures::largest>,
     "The same slide for the worst plant."},
    {"toeSlideMedian", "Toe slide, median", " mm", 1, EIdeal::Least, 3.0, 6.0, Slide<&Sums::toeSlide, &SlideMeasures::median>,
     "How much farther a planted toe slides over the floor than the source's, whether its heel is up or down: half of all plants are better."},
    {"toeSlideLargest", "Toe slide, worst", " mm", 1, EIdeal::Least, 15.0, 30.0, Slide<&Sums::toeSlide, &SlideMeasures::largest>,
     "The same slide for the worst plant."},
    {"contactF1", "Contacts F1", "", 3, EIdeal::Largest, 0.97, 0.9, Of<&Sums::contactF1>,
     "How well the frames in which feet stand match the source's, 1 being a perfect match; frames in which the source's foot moves at 15 to 30 cm/s do not count."},
    {"heldSole", "Held soles", " mm", 1, EIdeal::Least, 5.0, 15.0, Of<&Sums::heldSole>,
     "How far a sole is above or below the floor while the source's foot stands; one frame in twenty is worse."},
    {"sinking", "Sinking", " mm", 1, EIdeal::Least, 8.0, 20.0, SinkDepth,
     "How far the lower one of the soles is below the floor; one frame in twenty is worse."},
    {"kneePops", "Knee pops", "", 0, EIdeal::Least, 0.0, 2.0, KneePops,
     "How often a knee bends or straightens within 1/30 s by over 5° more than the source's does within 1/15 s before or after."},
    {"jitterRatio", "Leg jitter, median", "", 2, EIdeal::Least, 1.05, 1.3, Of<&Sums::jitterRatio>,
     "How much thighs and calves shake when seen at 30 frames a second, divided by the source's: half of these bones are better."},
    {"jitterRatioLargest", "Leg jitter, worst", "", 2, EIdeal::Least, 1.3, 1.6, Of<&Sums::jitterRatioLargest>,
     "The same ratio for the worst of these bones."},
    {"travelRatio", "Hip path", "", 3, EIdeal::One, 0.01, 0.05, Of<&Sums::travelRatio>,
     "How long the path of the hips over the ground is, divided by the source's; only where that is 50 cm or more."},
    {"handGap", "Hand gap", " mm", 1, EIdeal::Least, 30.0, 60.0, Of<&Sums::handGap>,
     "How much farther a hand is, or nearer, than the source's from the thigh, torso, head, other hand or floor that the source's touches; one frame in twenty is worse."},
    {"handDepth", "Hands below floor", " mm", 1, EIdeal::Least, 20.0, 50.0, Of<&Sums::handDepth>,
     "How far a hand gets below the floor at most."},
};
// clang-format on

// Returns how far a figure is from its ideal: smaller is better.
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

EVerdict VerdictOf(const KeyRow& row, const Optional& value)
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

std::string MarkOf(const KeyRow& row)
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
    std::vector<Optional> values;
    for (const KeyRow& row : kRows)
        values.push_back(row.value(measures, detail));
    return KeyFiguresFrom(values);
}

std::vector<KeyFigure> KeyFiguresFrom(std::span<const std::optional<double>> values)
{
    std::vector<KeyFigure> figures;
    for (const KeyRow& row : kRows)
    {
        const Optional value = figures.size() < values.size() ? values[figures.size()] : std::nullopt;
        figures.push_back({row.key, row.label, row.unit, row.decimals, value, VerdictOf(row, value),
                           MarkOf(row), row.meaning});
    }
    return figures;
}

double BadnessOf(const std::vector<KeyFigure>& figures)
{
    constexpr double kPoor = 1e6;
    constexpr double kFair = 1e3; // more than 180 degrees, the maximum of the first figure
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
