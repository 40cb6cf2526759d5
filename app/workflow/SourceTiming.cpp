#include "SourceTiming.h"

#include "CKeyframeControl.h"
#include "CMotionFile.h"
#include "COrrinStream.h"
#include "CProfileFields.h"

#include <algorithm>
#include <cmath>
#include <utility>
#include <vector>

namespace gw {

namespace {

// The capital F is correct: this is the name of an object, not of the class.
constexpr const char* kTrackName = "CKeyFrameControl";

CKeyframeControl* FirstTrack(CNode* root, const char* name, const CRTTI* record)
{
    std::vector<CObject*> found;
    if (root)
        root->FindObjects(found, name, record, false);
    return found.empty() ? nullptr : RecordCast<CKeyframeControl>(found.front());
}

} // namespace

SourceTiming TimingOf(const CMotionFile& motion)
{
    return {motion.GetLastFrame(), motion.GetFrequency()};
}

SourceTiming TimingOf(const CKeyframeControl* track)
{
    return track ? SourceTiming{track->m_fEndTime, track->m_fFrequency} : SourceTiming();
}

// Reads into a separate scene, because a damaged file must not change the current one.
bool LoadSourceScene(const std::string& path, COrrinStream& scene, CFailureRecord& record,
                     std::function<void(size_t, size_t)> progress, EPictures pictures)
{
    COrrinStream stream;
    stream.SetProgress(std::move(progress));
    if (pictures == EPictures::Named)
        stream.SetPictureLimit(0);
    const bool read = stream.LoadFile(path, false);
    record = stream.Record();
    if (read && !record.Failure() && !PreviewTrack(FirstNode(stream.GetRoot(0))))
        record.Fail(EFailure::NoTrack);
    if (!read || record.Failure())
        return false;
    scene.RemoveAllRoots();
    for (size_t i = 0; i < stream.GetRootCount(); ++i)
        scene.AddRoot(stream.GetRoot(i));
    return true;
}

CNode* FirstNode(CObject* root)
{
    return root ? RecordCast<CNode>(root->FindObject(nullptr, &CNode::ms_kRTTI, false)) : nullptr;
}

CKeyframeControl* PreviewTrack(CNode* root)
{
    return FirstTrack(root, nullptr, &CKeyframeControl::ms_kRTTI);
}

CKeyframeControl* ConversionTrack(CNode* root)
{
    CKeyframeControl* const named = FirstTrack(root, kTrackName, nullptr);
    return named ? named : PreviewTrack(root);
}

int SourceRateOf(CNode* root)
{
    constexpr double kUsual = 30.0;
    constexpr double kBeyond = 1e9; // fits into an int
    const CKeyframeControl* track = ConversionTrack(root);
    const double rate = track && track->m_fFrequency > 0.0f ? 1.0 / track->m_fFrequency : kUsual;
    return static_cast<int>(std::lround(std::min(rate, kBeyond)));
}

int ProfileRateOf(CNode* root)
{
    return std::clamp(SourceRateOf(root), kLowestFrameRate, kHighestFrameRate);
}

} // namespace gw
