// Joint positions in a BVH are added to the offset. Many writers put the complete position there, so that the
// offset is contained twice in the keys.

#include "DoubledOffsets.h"

#include "Alignment.h"
#include "CKeyframeControl.h"
#include "CTreePoser.h"

#include <algorithm>

namespace gw {

namespace {

constexpr int kDoubledSamples = 32;
constexpr double kRepeats = 0.01; // of an offset: positions this close to it repeat it
// If a file's positions are complete ones, those of joints that move are around the offset.
constexpr double kAround = 0.5;

// Compares a joint's keys with its offset, frame by frame.
class CDoubledMeter
{
public:
    explicit CDoubledMeter(const Vec3& offset) : m_kOffset(offset) {}

    void Add(const Vec3& position)
    {
        m_fLargest = std::max(m_fLargest, Vec3Length(position - m_kOffset * 2.0f));
        m_kSum = m_kSum + (position - m_kOffset);
        ++m_iFrames;
    }
    bool HasOffset() const { return m_kOffset != kVec3Zero && m_iFrames > 0; }
    bool Repeats() const { return HasOffset() && m_fLargest <= kRepeats * Vec3Length(m_kOffset); }
    bool StandsAround() const
    {
        const Vec3 mean = m_kSum * (1.0f / static_cast<float>(std::max(m_iFrames, 1)));
        return HasOffset() && Vec3Length(mean - m_kOffset) <= kAround * Vec3Length(m_kOffset);
    }

private:
    Vec3 m_kOffset;
    Vec3 m_kSum = kVec3Zero;
    double m_fLargest = 0.0;
    int m_iFrames = 0;
};

// Returns whether a joint keeps its position relative to its parent in all poses. Most joints only rotate.
bool IsStill(const CNode& joint)
{
    const CKeyframeControl* const track = TrackOf(joint);
    if (track != joint.GetControl() || joint.GetModifier())
        return false;
    return !track || (!track->GetNext() && track->GetTarget() == &joint && track->m_uiParentMask == 0 &&
                      track->m_kPositionKeys.Distinct().size() <= 1);
}

} // namespace

std::vector<bool> FindDoubled(CTreePoser& tree, const BodyMotion& motion)
{
    const auto& joints = tree.Joints();
    std::vector<CDoubledMeter> meters;
    meters.reserve(joints.size());
    for (const CNode* joint : joints)
        meters.emplace_back(joint == motion.root ? kVec3Zero : RestLocal(*joint).Translation());
    CPoseSampler moving(motion.frequency);
    for (CNode* joint : joints)
    {
        if (!IsStill(*joint))
            moving.Watch(joint);
    }
    tree.Pose(0);
    const int count = std::min(motion.frameCount, kDoubledSamples);
    for (int i = 0; i < count; ++i)
    {
        moving.Pose(static_cast<int>(static_cast<int64_t>(motion.frameCount) * i / count));
        for (size_t joint = 0; joint < joints.size(); ++joint)
            meters[joint].Add(joints[joint]->m_kMatrix.Translation());
    }
    const auto repeating = std::ranges::count_if(meters, &CDoubledMeter::Repeats);
    const auto around = std::ranges::count_if(meters, &CDoubledMeter::StandsAround);
    // In a file with complete positions, nearly all joints repeat their offset; some of the others move.
    const bool areWhole = repeating * 2 >= around && repeating > 0;
    std::vector<bool> doubled;
    doubled.reserve(meters.size());
    for (const CDoubledMeter& meter : meters)
        doubled.push_back(meter.Repeats() || (areWhole && meter.StandsAround()));
    return doubled;
}

} // namespace gw
