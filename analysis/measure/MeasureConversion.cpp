// Measures a conversion. The joints to measure are found once, in the pose of the first frame. Then these
// joints are posed frame by frame in both trees, and each meter reads what it needs. Bones keep running sums.
// The body stores a few joints per frame, because the floor is known only at the end, and with it which
// frames stand and what the hands touch.

#include "MeasureConversion.h"

#include "CBodyMeter.h"
#include "CBoneMeter.h"
#include "CDetailRecorder.h"
#include "CMotionFile.h"
#include "CPoseSampler.h"
#include "FrameScale.h"

#include <algorithm>
#include <optional>

namespace gw {

namespace {

constexpr double kUsualSecondsPerFrame = 1.0 / 30.0; // if a file has no usable frame time

BoneMeasures NamedBone(const BonePair& pair, const BoneEnds& ends)
{
    BoneMeasures bone;
    bone.target = pair.target->NameView();
    bone.source = pair.source->NameView();
    bone.targetChild = ends.target ? ends.target->NameView() : "";
    bone.sourceChild = ends.source ? ends.source->NameView() : "";
    return bone;
}

// Both trees must be posed at their first frame before a comparison is created.
class CComparison
{
public:
    CComparison(const MotionClip& source, const MotionClip& result, std::span<const BonePair> pairs,
                ConversionDetail* detail);

    void Run();
    ConversionMeasures Measures();

private:
    void WatchPair(const BonePair& pair, const BoneEnds& ends);
    void PlanBones(std::span<const BonePair> pairs);
    void WriteBones(ConversionMeasures& measures) const;

    double m_fFrameScale;
    double m_fSecondsPerFrame;
    int m_iFrameCount;
    CSourceTable m_kSources;
    CPoseSampler m_kSource;
    CPoseSampler m_kResult;
    std::vector<BoneMeasures> m_kBones;
    std::vector<CBoneMeter> m_kMeters;   // for the bones that can be measured
    std::vector<size_t> m_kMeteredBones; // the indices of these bones
    CBodyMeter m_kBody;
    ConversionDetail* m_pkDetail; // null if not requested
    std::optional<CDetailRecorder> recorder_;
};

CComparison::CComparison(const MotionClip& source, const MotionClip& result, std::span<const BonePair> pairs,
                         ConversionDetail* detail)
    : m_fFrameScale(FrameScaleOf(source.frameCount, result.frameCount)),
      m_fSecondsPerFrame(IsFrameTime(source.frequency) ? source.frequency : kUsualSecondsPerFrame),
      m_iFrameCount(ComparedFrames(source.frameCount, result.frameCount, m_fFrameScale)), m_kSources(pairs),
      m_kSource(source.frequency), m_kResult(result.frequency), m_kBody(pairs, m_kSources), m_pkDetail(detail)
{
    PlanBones(pairs);
    m_kBody.WatchJoints(m_kSource, m_kResult);
    m_kBody.Begin();
    if (!detail)
        return;
    *detail = {};
    detail->secondsPerFrame = m_fSecondsPerFrame;
    recorder_.emplace(*detail, pairs, m_kSources);
}

void CComparison::PlanBones(std::span<const BonePair> pairs)
{
    for (const BonePair& pair : pairs)
    {
        const BoneEnds ends = FindBoneEnds(pair, m_kSources);
        WatchPair(pair, ends);
        m_kBones.push_back(NamedBone(pair, ends));
        if (!ends.target || !ends.source)
            continue;
        m_kMeters.emplace_back(pair, ends);
        m_kMeteredBones.push_back(m_kBones.size() - 1);
    }
}

void CComparison::WatchPair(const BonePair& pair, const BoneEnds& ends)
{
    m_kSource.Watch(ends.sourceStart);
    m_kSource.Watch(ends.source);
    m_kResult.Watch(pair.target);
    m_kResult.Watch(ends.target);
}

void CComparison::Run()
{
    for (int frame = 0; frame < m_iFrameCount; ++frame)
    {
        m_kSource.Pose(frame);
        m_kResult.Pose(frame * m_fFrameScale);
        for (CBoneMeter& meter : m_kMeters)
            meter.Add();
        m_kBody.Add();
        if (recorder_)
            recorder_->Add();
    }
}

void CComparison::WriteBones(ConversionMeasures& measures) const
{
    measures.bones = m_kBones;
    CRunningMean errors;
    for (size_t i = 0; i < m_kMeters.size(); ++i)
    {
        BoneMeasures& bone = measures.bones[m_kMeteredBones[i]];
        m_kMeters[i].Write(bone);
        errors.Add(bone.meanError);
        measures.largestError = std::max(measures.largestError, bone.largestError);
    }
    measures.meanError = errors.Mean();
}

ConversionMeasures CComparison::Measures()
{
    ConversionMeasures measures;
    measures.frameCount = m_iFrameCount;
    measures.frameScale = m_fFrameScale;
    WriteBones(measures);
    m_kBody.Write(measures, m_fSecondsPerFrame, m_pkDetail);
    if (recorder_)
        recorder_->Finish();
    return measures;
}

bool HasFrames(const MotionClip& clip)
{
    return clip.root && clip.frameCount > 0;
}

} // namespace

MotionClip ClipOf(const CMotionFile& file)
{
    return {file.motionRoot.Get(), file.GetFrequency(), file.GetKeyCount()};
}

ConversionMeasures MeasureConversion(const MotionClip& source, const MotionClip& result,
                                     std::span<const BonePair> pairs, ConversionDetail* detail)
{
    if (!HasFrames(source) || !HasFrames(result))
        return {};
    source.root->UpdateTransform(0.0f);
    result.root->UpdateTransform(0.0f);
    CComparison comparison(source, result, pairs, detail);
    comparison.Run();
    return comparison.Measures();
}

} // namespace gw
