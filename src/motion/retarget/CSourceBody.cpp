#include "CSourceBody.h"

#include "CNode.h"
#include "Figures.h"

#include <algorithm>
#include <cmath>
#include <limits>

namespace gw {

namespace {

// A foot that stands rolls over its ball more often than over its heel.
constexpr double kFlatShare = 0.25;

// A joint jumps if its step is longer than this, in leg lengths, and than this many times both steps around
// it. The fastest kick accelerates over several frames.
constexpr double kJumpStep = 0.15;
constexpr double kJumpRatio = 5.0;

bool JumpsAfter(const std::vector<Vec3>& path, size_t frame, double leg)
{
    const auto step = [&](size_t from) { return Vec3Length(path[from + 1] - path[from]); };
    const double before = frame > 0 ? step(frame - 1) : 0.0;
    const double after = frame + 2 < path.size() ? step(frame + 1) : 0.0;
    return step(frame) > std::max({kJumpStep * leg, kJumpRatio * before, kJumpRatio * after});
}

} // namespace

CSourceBody::CSourceBody(const CNode* root, const std::vector<LegJoints>& legs)
    : m_pkRoot(root), m_kLegs(legs), m_kFeet(legs)
{
}

std::vector<CNode*> CSourceBody::Joints() const
{
    std::vector<CNode*> joints;
    for (const LegJoints& leg : m_kLegs)
    {
        for (CNode* joint : {leg.thigh, leg.knee, leg.ankle, leg.toe})
        {
            if (joint)
                joints.push_back(joint);
        }
    }
    return joints;
}

void CSourceBody::Append()
{
    if (m_kRoots.empty())
        m_kFeet.MeasureLegs();
    m_kFeet.AppendPlaces();
    m_kRoots.push_back(m_pkRoot ? m_pkRoot->m_kWorldMatrix.Translation() : kVec3Zero);
    Vec3 hips = kVec3Zero;
    for (const LegJoints& leg : m_kLegs)
        hips = hips + leg.thigh->m_kWorldMatrix.Translation() * (1.0f / static_cast<float>(m_kLegs.size()));
    m_kHips.push_back(hips);
}

bool CSourceBody::HasLegs() const
{
    return LegLength() > 0.0 && std::isfinite(LegLength());
}

float CSourceBody::Floor(double leastToe) const
{
    std::vector<float> soles;
    for (const CLegTrack& leg : m_kFeet.Legs())
    {
        const auto ankle = static_cast<float>(leg.AnkleHeight());
        const auto toe = static_cast<float>(std::max(leg.ToeHeight(), leastToe));
        for (size_t frame = 0; frame < leg.Toes().size(); ++frame)
            soles.push_back(std::min(leg.Ankles()[frame].y - ankle, leg.Toes()[frame].y - toe));
    }
    return soles.empty() ? std::numeric_limits<float>::quiet_NaN()
                         : Percentile(std::move(soles), kFloorShare);
}

void CSourceBody::FindTouches(double secondsPerFrame)
{
    FootTouches none;
    none.states.resize(FrameCount());
    m_kTouches =
        HasLegs() ? m_kFeet.Touches(secondsPerFrame) : std::vector<FootTouches>(m_kLegs.size(), none);
    m_kJumps.clear();
    for (size_t frame = 0; frame + 1 < FrameCount(); ++frame)
    {
        const auto jump = [&](const std::vector<Vec3>& path) { return JumpsAfter(path, frame, LegLength()); };
        if (jump(m_kHips) || std::ranges::any_of(m_kFeet.Legs(), jump, &CLegTrack::Ankles))
            m_kJumps.push_back(frame);
    }
}

float CSourceBody::FlatDrop() const
{
    std::vector<float> drops;
    for (size_t leg = 0; leg < m_kLegs.size(); ++leg)
    {
        const CLegTrack& track = Leg(leg);
        if (!track.HasToe())
            continue;
        for (const Contact& contact : m_kTouches[leg].flat)
        {
            for (auto frame = static_cast<size_t>(contact.first); frame < static_cast<size_t>(contact.end);
                 ++frame)
                drops.push_back(track.Ankles()[frame].y - track.Toes()[frame].y);
        }
    }
    if (drops.empty())
        return FloorOf(m_kFeet.Legs(), &CLegTrack::Ankles) - FloorOf(m_kFeet.Legs(), &CLegTrack::Toes);
    return Percentile(std::move(drops), kFlatShare);
}

} // namespace gw
