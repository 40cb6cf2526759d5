#include "WorstFrames.h"

#include "HostBones.h"

#include <algorithm>
#include <cmath>
#include <cstdlib>

namespace gw {

namespace {

constexpr double kSecondsApart = 0.5;

// The largest values that are not visible in a single frame, by EFrameFault: degrees or mm.
constexpr double kPassing[] = {
    5.0,  // Direction
    5.0,  // Trunk
    5.0,  // KneePop
    15.0, // AnkleSlide
    15.0, // ToeSlide
    15.0, // HeldSole: a foot that lands or lifts off is slightly off the floor
    30.0, // HandGap
    20.0, // HandDepth
};

double SeverityOf(const WorstFrame& worst)
{
    return worst.amount / kPassing[static_cast<size_t>(worst.fault)];
}

WorstFrame DirectionFault(const ConversionDetail& detail, size_t frame)
{
    const size_t bone = detail.largestBone[frame];
    return {EFrameFault::Direction,
            static_cast<int>(frame),
            static_cast<double>(detail.meanError[frame]),
            detail.mainBones[bone],
            detail.mainSources[bone],
            static_cast<double>(detail.largestError[frame]),
            {}};
}

// Adds the frame with the largest direction error that is far enough from all added ones. Returns false if
// there is none.
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

void AddDirection(const ConversionDetail& detail, std::vector<WorstFrame>& worst)
{
    const auto largest = std::ranges::max_element(detail.meanError);
    if (largest != detail.meanError.end())
        worst.push_back(DirectionFault(detail, static_cast<size_t>(largest - detail.meanError.begin())));
}

void AddTrunk(const ConversionMeasures& measures, std::vector<WorstFrame>& worst)
{
    for (const BoneMeasures& bone : measures.bones)
    {
        if (bone.target == kNeckBone && measures.trunkMean)
            worst.push_back({EFrameFault::Trunk,
                             measures.trunkFrame,
                             measures.trunkLargest,
                             bone.target,
                             bone.source,
                             0.0,
                             {}});
    }
}

void AddFeet(const std::vector<FootMeasures>& feet, std::vector<WorstFrame>& worst)
{
    for (const FootMeasures& foot : feet)
    {
        const auto add = [&](EFrameFault fault, int frame, double amount) {
            worst.push_back({fault, frame, amount, foot.target, foot.source, 0.0, {}});
        };
        add(EFrameFault::KneePop, foot.kneePopFrame, foot.kneePopLargest);
        add(EFrameFault::AnkleSlide, foot.ankleSlide.largestFrame, foot.ankleSlide.largest);
        add(EFrameFault::ToeSlide, foot.toeSlide.largestFrame, foot.toeSlide.largest);
        add(EFrameFault::HeldSole, foot.heldSoleFrame, foot.heldSoleLargest.value_or(0.0));
    }
}

void AddHands(const std::vector<HandMeasures>& hands, std::vector<WorstFrame>& worst)
{
    for (const HandMeasures& hand : hands)
    {
        worst.push_back({EFrameFault::HandGap, hand.gapFrame, hand.gapLargest, hand.target, hand.source, 0.0,
                         hand.gapPart});
        worst.push_back(
            {EFrameFault::HandDepth, hand.depthFrame, hand.depth, hand.target, hand.source, 0.0, {}});
    }
}

// If both sides have the same fault, keeps only the worse one.
void KeepWorstOfEach(std::vector<WorstFrame>& worst)
{
    std::vector<WorstFrame> kept;
    for (WorstFrame& frame : worst)
    {
        if (std::ranges::count(kept, frame.fault, &WorstFrame::fault) == 0)
            kept.push_back(std::move(frame));
    }
    worst = std::move(kept);
}

} // namespace

std::vector<WorstFrame> FindWorstFrames(const ConversionMeasures& measures, const ConversionDetail& detail,
                                        size_t count)
{
    std::vector<WorstFrame> worst;
    AddDirection(detail, worst);
    AddTrunk(measures, worst);
    AddFeet(measures.feet, worst);
    AddHands(measures.hands, worst);
    std::erase_if(worst, [](const WorstFrame& frame) { return !(SeverityOf(frame) > 1.0); });
    std::ranges::stable_sort(worst, std::ranges::greater(), SeverityOf);
    KeepWorstOfEach(worst);
    worst.resize(std::min(worst.size(), count));
    while (worst.size() < count && AddNextDirection(detail, worst))
    {
    }
    return worst;
}

} // namespace gw
