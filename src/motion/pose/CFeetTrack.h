#pragma once

#include "CLegTrack.h"
#include "FindContacts.h"

#include <vector>

namespace gw {

class CPoseSampler;

/// When one foot touches the floor.
struct FootTouches
{
    /// Frames in which the ankle or the toe stands, whatever the other does: for example, a heel that has
    /// come down or a ball that pushes off.
    std::vector<Contact> contacts;
    /// Confidence, 0 to 1, that the sole is on the floor; one value per frame. It is 1 in a contact in which
    /// ankle and toe stand together, less if only one stands and hovers, and 0 outside of contacts.
    std::vector<float> landed;
    /// Frames in which ankle and toe stand together.
    std::vector<Contact> flat;
    /// Confidence, 0 to 1, that the foot is still without standing; one value per frame.
    std::vector<float> aloft;
    /// Height of the higher of ankle and toe above its floor in leg lengths; one value per frame.
    std::vector<float> heights;
    /// Same for the lower of the two.
    std::vector<float> lowHeights;
    /// Height of the ankle above its floor in leg lengths; one value per frame.
    std::vector<float> ankleHeights;
    /// Confidence, 0 to 1, that the foot has landed and hardly moves; one value per frame.
    std::vector<float> settled;
    /// Frames in which the ankle stands, whatever the toe does.
    std::vector<Contact> ankle;
    /// Same for the toe; empty for a foot without one.
    std::vector<Contact> toe;
};

/// Returns the height at which a joint, `Ankles` or `Toes`, of all legs stands on the floor.
float FloorOf(const std::vector<CLegTrack>& legs, const std::vector<Vec3>& (CLegTrack::*joint)() const);

/// Records the feet of one skeleton, frame by frame.
class CFeetTrack
{
public:
    /// The tree may be in any pose; the floor is found from the rest pose.
    explicit CFeetTrack(const std::vector<LegJoints>& legs);

    /// Makes a sampler pose the joints of the legs.
    void WatchJoints(CPoseSampler& sampler) const;
    /// Adds the current pose as the next frame.
    void Append();
    /// Adds only the positions of ankles and toes as the next frame. Contacts need nothing else.
    void AppendPlaces();
    /// Measures the length of the legs in the current pose.
    void MeasureLegs();

    std::vector<CLegTrack>& Legs() { return m_kLegs; }
    const std::vector<CLegTrack>& Legs() const { return m_kLegs; }
    /// Returns the mean length of the legs, in the skeleton's units; 0 without legs or before MeasureLegs.
    double LegLength() const { return m_fLegLength; }
    /// Returns when each leg touches the floor. The legs must have been measured.
    std::vector<FootTouches> Touches(double secondsPerFrame) const;

private:
    void FindAloft(const std::vector<FootMotion>& motion, FootTouches& touches) const;
    FootTouches TouchesOf(const CLegTrack& leg, float ankleFloor, float toeFloor,
                          double secondsPerFrame) const;

    std::vector<CLegTrack> m_kLegs;
    double m_fLegLength = 0.0;
};

} // namespace gw
