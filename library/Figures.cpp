#include "Figures.h"

#include "ConvertedMotion.h"
#include "FaultWords.h"
#include "KeyFigures.h"
#include "WorstFrames.h"

namespace gaitwright {

namespace {

SlideFigures Copy(const gw::SlideMeasures& slide)
{
    return {slide.plants, slide.median, slide.largest, slide.largestFrame};
}

BoneFigures Copy(const gw::BoneMeasures& bone)
{
    return {.target = bone.target,
            .source = bone.source,
            .targetChild = bone.targetChild,
            .sourceChild = bone.sourceChild,
            .measured = bone.measured,
            .meanError = bone.meanError,
            .largestError = bone.largestError,
            .largestFrame = bone.largestFrame};
}

PartFigures Copy(const gw::PartMeasures& part)
{
    return {.part = std::string(part.name),
            .boneCount = part.boneCount,
            .meanError = part.meanError,
            .largestError = part.largestError,
            .largestBone = part.largestBone,
            .largestFrame = part.largestFrame};
}

FootFigures Copy(const gw::FootMeasures& foot)
{
    return {.target = foot.target,
            .source = foot.source,
            .turnMean = foot.turnMean,
            .turnError = foot.turnError,
            .turnLargest = foot.turnLargest,
            .turnWhileStanding = foot.turnWhileStanding,
            .turnFromStart = foot.turnFromStart,
            .soleTiltMean = foot.soleTiltMean,
            .soleTiltLargest = foot.soleTiltLargest,
            .sourceSoleTiltMean = foot.sourceSoleTiltMean,
            .ankleSlide = Copy(foot.ankleSlide),
            .toeSlide = Copy(foot.toeSlide),
            .sourceContacts = foot.sourceContacts,
            .resultContacts = foot.resultContacts,
            .sourceStanding = foot.sourceStanding,
            .resultStanding = foot.resultStanding,
            .bothStanding = foot.bothStanding,
            .contactF1 = foot.contactF1,
            .heldSole = foot.heldSole,
            .heldSoleLargest = foot.heldSoleLargest,
            .heldSoleFrame = foot.heldSoleFrame,
            .kneePops = foot.kneePops,
            .kneePopLargest = foot.kneePopLargest,
            .kneePopFrames = foot.kneePopFrames};
}

HandFigures Copy(const gw::HandMeasures& hand)
{
    return {.target = hand.target,
            .source = hand.source,
            .touchFrames = hand.touchFrames,
            .gap = hand.gap,
            .gapPart = hand.gapPart,
            .gapLargest = hand.gapLargest,
            .gapFrame = hand.gapFrame,
            .depth = hand.depth,
            .depthFrame = hand.depthFrame};
}

WorstFrame Copy(const gw::WorstFrame& worst)
{
    return {.frame = worst.frame,
            .fault = gw::WordsOf(worst.fault).name,
            .amount = worst.amount,
            .target = worst.target,
            .source = worst.source,
            .part = worst.part};
}

KeyFigure Copy(const gw::KeyFigure& figure)
{
    return {.key = std::string(figure.key), .value = figure.value};
}

template <class Record>
auto CopyAll(const std::vector<Record>& records)
{
    std::vector<decltype(Copy(records.front()))> copies;
    copies.reserve(records.size());
    for (const Record& record : records)
        copies.push_back(Copy(record));
    return copies;
}

} // namespace

Figures FiguresOf(const gw::MeasuredConversion& measured)
{
    const gw::ConversionMeasures& sums = measured.sums;
    return {.frameCount = sums.frameCount,
            .frameScale = sums.frameScale,
            .sourceLeg = sums.sourceLeg,
            .resultLeg = sums.resultLeg,
            .meanError = sums.meanError,
            .largestError = sums.largestError,
            .trunkMean = sums.trunkMean,
            .trunkMost = sums.trunkMost,
            .trunkLargest = sums.trunkLargest,
            .trunkFrame = sums.trunkFrame,
            .jitterRatio = sums.jitterRatio,
            .jitterRatioLargest = sums.jitterRatioLargest,
            .ankleSlide = Copy(sums.ankleSlide),
            .toeSlide = Copy(sums.toeSlide),
            .contactF1 = sums.contactF1,
            .heldSole = sums.heldSole,
            .sinkDepth = sums.sinkDepth,
            .handGap = sums.handGap,
            .handDepth = sums.handDepth,
            .sourceTravel = sums.sourceTravel,
            .resultTravel = sums.resultTravel,
            .travelRatio = sums.travelRatio,
            .bones = CopyAll(sums.bones),
            .parts = CopyAll(measured.detail.parts),
            .feet = CopyAll(sums.feet),
            .hands = CopyAll(sums.hands),
            .worstFrames = CopyAll(gw::FindWorstFrames(sums, measured.detail, gw::kWorstFrames)),
            .keyFigures = CopyAll(gw::KeyFiguresOf(sums, measured.detail))};
}

} // namespace gaitwright
