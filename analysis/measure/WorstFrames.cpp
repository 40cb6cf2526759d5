#include "WorstFrames.h"

#include <algorithm>
#include <cmath>
#include <cstdlib>

namespace gw {

namespace {

constexpr double kSecondsApart = 0.5;

WorstFrame DirectionFault(const ConversionDetail& detail, size_t frame)
{
    const size_t bone = detail.largestBone[frame];
    return {
        EFrameFault::Direction, static_cast<int>(frame),  static_cast<double>(detail.meanError[frame]),
        detail.mainBones[bone], detail.mainSources[bone], static_cast<double>(detail.largestError[frame])};
}

// Adds the frame of the largest direction error that is far enough from all that stand. False where there is
// none.
bool AddNextDirection(const ConversionDetail& detail, std::vector<WorstFrame>& worst)
{
    const double frames = kSecondsApart / detail.secondsPerFrame;
    const auto apart =
        static_cast<int>(std::round(std::min(frames, static_cast<double>(detail.meanError.size()))));
    const auto isNear = [=](const WorstFrame& other, int frame) {
        return std::abs(other.frame - frame) < std::max(apart, 1);
    };
    const size_t none = detail.meanError.size();
    size_t largest = none;
    for (size_t f = 0; f < none; ++f)
    {
        const bool isLarger = largest == none || detail.meanError[f] > detail.meanError[largest];
        const bool isTaken = std::ranges::any_of(
            worst, [&](const WorstFrame& other) { return isNear(other, static_cast<int>(f)); });
        if (isLarger && !isTaken && detail.meanError[f] > 0.0f)
            largest = f;
    }
    if (largest == none)
        return false;
    worst.push_back(DirectionFault(detail, largest));
    return true;
}

void AddWorstPop(const std::vector<FootMeasures>& feet, std::vector<WorstFrame>& worst)
{
    const auto foot = std::ranges::max_element(feet, {}, &FootMeasures::kneePopLargest);
    if (foot != feet.end() && foot->kneePops > 0)
        worst.push_back(
            {EFrameFault::KneePop, foot->kneePopFrame, foot->kneePopLargest, foot->target, foot->source});
}

void AddWorstSlide(const std::vector<FootMeasures>& feet, std::vector<WorstFrame>& worst)
{
    const auto foot = std::ranges::max_element(feet, {}, &FootMeasures::addedSlideLargest);
    if (foot != feet.end() && foot->addedSlideLargest >= kNamedSlide)
        worst.push_back(
            {EFrameFault::Slide, foot->addedSlideFrame, foot->addedSlideLargest, foot->target, foot->source});
}

} // namespace

std::vector<WorstFrame> FindWorstFrames(const ConversionMeasures& measures, const ConversionDetail& detail,
                                        size_t count)
{
    std::vector<WorstFrame> worst;
    AddNextDirection(detail, worst);
    AddWorstPop(measures.feet, worst);
    AddWorstSlide(measures.feet, worst);
    worst.resize(std::min(worst.size(), count));
    while (worst.size() < count && AddNextDirection(detail, worst))
    {
    }
    return worst;
}

} // namespace gw
