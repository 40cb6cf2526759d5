#include "CDetailRecorder.h"

#include "BodyParts.h"
#include "CNode.h"
#include "HostBones.h"

#include <algorithm>
#include <cmath>

namespace gw {

namespace {

constexpr size_t kMostMainBones =
    255; // what a byte of ConversionDetail::largestBone holds; there are a dozen

PartMeasures MeasurePart(const BodyPart& part, const std::vector<BoneMeasures>& bones)
{
    PartMeasures measures;
    measures.name = part.name;
    CRunningMean errors;
    for (const BoneMeasures& bone : bones)
    {
        if (std::ranges::count(part.bones, bone.target) == 0)
            continue;
        errors.Add(bone.meanError);
        if (errors.Count() > 1 && bone.largestError <= measures.largestError)
            continue;
        measures.largestError = bone.largestError;
        measures.largestBone = bone.target;
        measures.largestFrame = bone.largestFrame;
    }
    measures.boneCount = errors.Count();
    measures.meanError = errors.Mean();
    return measures;
}

// From the first place on in x and z; above a floor in y.
void MoveToStart(std::vector<Vec3>& places, double floor, double scale)
{
    if (places.empty())
        return;
    const Vec3 start{places.front().x, static_cast<float>(floor), places.front().z};
    for (Vec3& place : places)
        place = (place - start) * static_cast<float>(scale);
}

} // namespace

CDetailRecorder::CDetailRecorder(ConversionDetail& detail, std::span<const BonePair> pairs,
                                 const CSourceTable& sources, const CNode* resultRoot)
    : detail_(detail), m_pkSourceRoot(sources.SourceOf(resultRoot)), m_pkResultRoot(resultRoot)
{
    for (const BonePair& pair : pairs)
    {
        if (IsMainBone(pair.target->NameView()) && m_kMeters.size() < kMostMainBones)
            AddMainBone(pair, sources);
    }
}

void CDetailRecorder::AddMainBone(const BonePair& pair, const CSourceTable& sources)
{
    BoneEnds ends = FindBoneEnds(pair, sources);
    if (!ends.target || !ends.source)
    {
        if (pair.target->NameView() != kHeadBone)
            return;
        ends = {nullptr, nullptr, pair.source};
    }
    m_kMeters.emplace_back(pair, ends);
    detail_.mainBones.emplace_back(pair.target->NameView());
    detail_.mainSources.emplace_back(pair.source->NameView());
}

void CDetailRecorder::AddErrors()
{
    if (m_kMeters.empty())
        return;
    CRunningMean errors;
    size_t largest = 0;
    for (size_t i = 0; i < m_kMeters.size(); ++i)
    {
        m_kMeters[i].Add();
        const double error = m_kMeters[i].LastError();
        if (errors.Count() == 0 || error > errors.Largest())
            largest = i;
        errors.Add(error);
    }
    detail_.meanError.push_back(static_cast<float>(errors.Mean()));
    detail_.largestError.push_back(static_cast<float>(errors.Largest()));
    detail_.largestBone.push_back(static_cast<uint8_t>(largest));
}

void CDetailRecorder::Add()
{
    AddErrors();
    if (!m_pkSourceRoot)
        return;
    detail_.sourceRoot.push_back(m_pkSourceRoot->m_kWorldMatrix.Translation());
    detail_.resultRoot.push_back(m_pkResultRoot->m_kWorldMatrix.Translation());
}

void CDetailRecorder::FinishParts()
{
    std::vector<BoneMeasures> bones(m_kMeters.size());
    for (size_t i = 0; i < bones.size(); ++i)
    {
        m_kMeters[i].Write(bones[i]);
        bones[i].target = detail_.mainBones[i];
    }
    for (const BodyPart& part : BodyParts())
        detail_.parts.push_back(MeasurePart(part, bones));
}

void CDetailRecorder::Finish(const ConversionMeasures& measures)
{
    FinishParts();
    if (measures.sourceLeg > 0.0 && measures.resultLeg > 0.0)
    {
        MoveToStart(detail_.sourceRoot, detail_.sourceFloor, measures.resultLeg / measures.sourceLeg);
        MoveToStart(detail_.resultRoot, 0.0, 1.0);
        return;
    }
    detail_.sourceRoot.clear();
    detail_.resultRoot.clear();
}

} // namespace gw
