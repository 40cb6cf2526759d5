#include "CDetailRecorder.h"

#include "BodyParts.h"
#include "CNode.h"
#include "HostBones.h"

#include <algorithm>
#include <cmath>

namespace gw {

namespace {

constexpr size_t kMostMainBones =
    255; // fits in a byte of ConversionDetail::largestBone; there are about a dozen

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

} // namespace

CDetailRecorder::CDetailRecorder(ConversionDetail& detail, std::span<const BonePair> pairs,
                                 const CSourceTable& sources)
    : detail_(detail)
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

void CDetailRecorder::Add()
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

void CDetailRecorder::Finish()
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

} // namespace gw
