#include "SourceTiming.h"

#include "CKeyframeControl.h"
#include "CMotionFile.h"

#include <vector>

namespace gw {

namespace {

// The capital F is right: this is the name of an object and not of the class.
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

} // namespace gw
