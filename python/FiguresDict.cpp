// Figures as a dict, under the names that the shell program's reports have.

#include "Values.h"

namespace gaitwright::python {

namespace {

py::dict Dict(const SlideFigures& slide)
{
    py::dict dict;
    dict["plants"] = slide.plants;
    dict["median"] = slide.median;
    dict["largest"] = slide.largest;
    dict["largestFrame"] = slide.largestFrame;
    return dict;
}

py::dict Dict(const BoneFigures& bone)
{
    py::dict dict;
    dict["target"] = ToPython(bone.target);
    dict["source"] = ToPython(bone.source);
    dict["targetChild"] = ToPython(bone.targetChild);
    dict["sourceChild"] = ToPython(bone.sourceChild);
    dict["measured"] = bone.measured;
    dict["meanError"] = bone.meanError;
    dict["largestError"] = bone.largestError;
    dict["largestFrame"] = bone.largestFrame;
    return dict;
}

py::dict Dict(const PartFigures& part)
{
    py::dict dict;
    dict["part"] = ToPython(part.part);
    dict["bones"] = part.boneCount;
    dict["meanError"] = part.meanError;
    dict["largestError"] = part.largestError;
    dict["largestBone"] = ToPython(part.largestBone);
    dict["largestFrame"] = part.largestFrame;
    return dict;
}

void AddContacts(py::dict& dict, const FootFigures& foot)
{
    dict["sourceContacts"] = foot.sourceContacts;
    dict["resultContacts"] = foot.resultContacts;
    dict["sourceStanding"] = foot.sourceStanding;
    dict["resultStanding"] = foot.resultStanding;
    dict["bothStanding"] = foot.bothStanding;
    dict["contactF1"] = ToPython(foot.contactF1);
    dict["heldSole"] = ToPython(foot.heldSole);
    dict["heldSoleLargest"] = ToPython(foot.heldSoleLargest);
    dict["heldSoleFrame"] = foot.heldSoleFrame;
}

py::dict Dict(const FootFigures& foot)
{
    py::dict dict;
    dict["target"] = ToPython(foot.target);
    dict["source"] = ToPython(foot.source);
    dict["turnMean"] = foot.turnMean;
    dict["turnError"] = foot.turnError;
    dict["turnLargest"] = foot.turnLargest;
    dict["turnWhileStanding"] = foot.turnWhileStanding;
    dict["turnFromStart"] = foot.turnFromStart;
    dict["soleTiltMean"] = foot.soleTiltMean;
    dict["soleTiltLargest"] = foot.soleTiltLargest;
    dict["sourceSoleTiltMean"] = foot.sourceSoleTiltMean;
    dict["ankleSlide"] = Dict(foot.ankleSlide);
    dict["toeSlide"] = Dict(foot.toeSlide);
    AddContacts(dict, foot);
    dict["kneePops"] = foot.kneePops;
    dict["kneePopLargest"] = foot.kneePopLargest;
    dict["kneePopFrames"] = py::list(TupleOf(foot.kneePopFrames));
    return dict;
}

py::dict Dict(const HandFigures& hand)
{
    py::dict dict;
    dict["target"] = ToPython(hand.target);
    dict["source"] = ToPython(hand.source);
    dict["touchFrames"] = hand.touchFrames;
    dict["gap"] = ToPython(hand.gap);
    dict["gapPart"] = ToPython(hand.gapPart);
    dict["gapLargest"] = hand.gapLargest;
    dict["gapFrame"] = hand.gapFrame;
    dict["depth"] = hand.depth;
    dict["depthFrame"] = hand.depthFrame;
    return dict;
}

py::dict Dict(const WorstFrame& worst)
{
    py::dict dict;
    dict["frame"] = worst.frame;
    dict["fault"] = ToPython(worst.fault);
    dict["amount"] = worst.amount;
    dict["target"] = ToPython(worst.target);
    dict["source"] = ToPython(worst.source);
    if (!worst.part.empty())
        dict["part"] = ToPython(worst.part);
    return dict;
}

template <class Item>
py::list ListOf(const std::vector<Item>& items)
{
    py::list list;
    for (const Item& item : items)
        list.append(Dict(item));
    return list;
}

void AddDirections(py::dict& dict, const Figures& figures)
{
    dict["meanError"] = figures.meanError;
    dict["largestError"] = figures.largestError;
    dict["trunkMean"] = ToPython(figures.trunkMean);
    dict["trunkMost"] = ToPython(figures.trunkMost);
    dict["trunkLargest"] = figures.trunkLargest;
    dict["trunkFrame"] = figures.trunkFrame;
    dict["jitterRatio"] = ToPython(figures.jitterRatio);
    dict["jitterRatioLargest"] = ToPython(figures.jitterRatioLargest);
}

} // namespace

py::dict DictOf(const Figures& figures)
{
    py::dict dict;
    dict["frameCount"] = figures.frameCount;
    dict["frameScale"] = figures.frameScale;
    dict["sourceLeg"] = figures.sourceLeg;
    dict["resultLeg"] = figures.resultLeg;
    AddDirections(dict, figures);
    dict["ankleSlide"] = Dict(figures.ankleSlide);
    dict["toeSlide"] = Dict(figures.toeSlide);
    dict["contactF1"] = ToPython(figures.contactF1);
    dict["heldSole"] = ToPython(figures.heldSole);
    dict["sinkDepth"] = figures.sinkDepth;
    dict["handGap"] = ToPython(figures.handGap);
    dict["handDepth"] = ToPython(figures.handDepth);
    dict["sourceTravel"] = figures.sourceTravel;
    dict["resultTravel"] = figures.resultTravel;
    dict["travelRatio"] = ToPython(figures.travelRatio);
    dict["bones"] = ListOf(figures.bones);
    dict["parts"] = ListOf(figures.parts);
    dict["feet"] = ListOf(figures.feet);
    dict["hands"] = ListOf(figures.hands);
    dict["worstFrames"] = ListOf(figures.worstFrames);
    py::dict keyFigures;
    for (const KeyFigure& figure : figures.keyFigures)
        keyFigures[ToPython(figure.key)] = ToPython(figure.value);
    dict["keyFigures"] = keyFigures;
    return dict;
}

} // namespace gaitwright::python
