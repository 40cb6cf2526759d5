#pragma once

#include "CLegTrack.h"
#include "FindContacts.h"

#include <vector>

namespace gw {

class CPoseSampler;

/// The touches of one foot.
struct FootTouches
{
    /// Frames in which the ankle or the toe stands, whatever the other does: a heel that has come down, a
    /// ball that pushes off.
    std::vector<Contact> contacts;
    /// How surely the sole is on the floor, 0 to 1, frame by frame: 1 where ankle and toe stand together;
    /// less where one alone does and hovers.
    std::vector<float> landed;
};

/// Returns the height at which a joint, `Ankles` or `Toes`, of all legs stands on the floor.
float FloorOf(const std::vector<CLegTrack>& legs, const std::vector<Vec3>& (CLegTrack::*joint)() const);

/// The feet of one skeleton while frames go by.
class CFeetTrack
{
public:
    explicit CFeetTrack(const std::vector<LegJoints>& legs);

    void WatchJoints(CPoseSampler& sampler) const;
    /// Takes the present pose as the next frame.
    void Append();
    /// The same for ankles and toes alone: what contacts are found by.
    void AppendPlaces();
    /// Takes the present pose for how long the legs are.
    void MeasureLegs();

    std::vector<CLegTrack>& Legs() { return m_kLegs; }
    const std::vector<CLegTrack>& Legs() const { return m_kLegs; }
    /// The legs' mean length, or 0 without legs.
    double LegLength() const { return m_fLegLength; }
    /// The contacts of each leg.
    std::vector<std::vector<Contact>> Contacts(double secondsPerFrame) const;
    /// What each leg touches the floor with.
    std::vector<FootTouches> Touches(double secondsPerFrame) const;

private:
    FootTouches TouchesOf(const CLegTrack& leg, const std::vector<Contact>& flat, float ankleFloor,
                          float toeFloor, double secondsPerFrame) const;

    std::vector<CLegTrack> m_kLegs;
    double m_fLegLength = 0.0;
};

} // namespace gw
