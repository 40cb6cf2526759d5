#include "CLegTrack.h"

#include "BodyPose.h"
#include "CPoseSampler.h"
#include "Directions.h"

namespace gw {

CLegTrack::CLegTrack(const LegJoints& joints, double restFloor)
    : m_kJoints(joints), m_kHeelSole(SoleUnder(*joints.ankle, restFloor)),
      m_kSoleNormal(ToLocal(kVec3UnitY, NormalizedRows(RestWorld(*joints.ankle))))
{
    if (HasToe())
        m_kToeSole = SoleUnder(*joints.toe, restFloor);
}

void CLegTrack::WatchJoints(CPoseSampler& sampler) const
{
    for (CNode* joint : {m_kJoints.thigh, m_kJoints.knee, m_kJoints.ankle, m_kJoints.toe})
        sampler.Watch(joint);
}

double CLegTrack::Length() const
{
    const Vec3 knee = PlaceOf(*m_kJoints.knee);
    return Vec3Length(knee - PlaceOf(*m_kJoints.thigh)) + Vec3Length(PlaceOf(*m_kJoints.ankle) - knee);
}

double CLegTrack::AnkleHeight() const
{
    return Vec3Length(m_kHeelSole);
}

double CLegTrack::ToeHeight() const
{
    return Vec3Length(m_kToeSole);
}

Vec3 CLegTrack::Heading() const
{
    if (HasToe())
        return Vec3Normalized(PlaceOf(*m_kJoints.toe) - PlaceOf(*m_kJoints.ankle));
    return Turned(m_kHeading, NormalizedRows(m_kJoints.ankle->m_kWorldMatrix));
}

void CLegTrack::SetHeading(const Vec3& direction)
{
    m_kHeading = ToLocal(direction, NormalizedRows(m_kJoints.ankle->m_kWorldMatrix));
}

float CLegTrack::SoleHeight() const
{
    const float heel = TransformCoord(m_kHeelSole, m_kJoints.ankle->m_kWorldMatrix).y;
    return HasToe() ? std::min(heel, TransformCoord(m_kToeSole, m_kJoints.toe->m_kWorldMatrix).y) : heel;
}

void CLegTrack::AppendPlaces()
{
    m_kAnkles.push_back(PlaceOf(*m_kJoints.ankle));
    if (HasToe())
        m_kToes.push_back(PlaceOf(*m_kJoints.toe));
}

void CLegTrack::Append()
{
    AppendPlaces();
    const Vec3 knee = PlaceOf(*m_kJoints.knee);
    const Vec3 ankle = PlaceOf(*m_kJoints.ankle);
    const Vec3 normal = Turned(m_kSoleNormal, NormalizedRows(m_kJoints.ankle->m_kWorldMatrix));
    m_kPostures.push_back({Heading(), static_cast<float>(AngleBetween(normal, kVec3UnitY)), SoleHeight(),
                           static_cast<float>(AngleBetween(knee - PlaceOf(*m_kJoints.thigh), ankle - knee))});
}

Vec3 SoleUnder(const CNode& joint, double restFloor)
{
    const Mat4 world = RestWorld(joint);
    Vec3 point = world.Translation();
    point.y = static_cast<float>(restFloor);
    return TransformCoord(point, Mat4InverseOrIdentity(world));
}

double RestFloor(const std::vector<LegJoints>& legs)
{
    double lowest = 0.0;
    double calf = 0.0;
    for (size_t i = 0; i < legs.size(); ++i)
    {
        const Vec3 ankle = RestWorld(*legs[i].ankle).Translation();
        const float toe = legs[i].toe ? RestWorld(*legs[i].toe).Translation().y : ankle.y;
        const auto height = static_cast<double>(std::min(ankle.y, toe));
        lowest = i == 0 ? height : std::min(lowest, height);
        calf = std::max(calf, Vec3Length(ankle - RestWorld(*legs[i].knee).Translation()));
    }
    // An ankle is about a fifth of the calf's length above the sole. The feet of a skeleton whose hip is at
    // the origin are about two calf lengths below it.
    const bool stands = lowest >= 0.0 && lowest < 0.5 * calf;
    return stands ? 0.0 : lowest;
}

} // namespace gw
