#pragma once

#include "CLegTrack.h"
#include "FindContacts.h"

#include <vector>

namespace gw {

class CPoseSampler;

/// How a foot stands in a frame. Confidences are 0 to 1, heights in leg lengths above the joint's own floor.
struct FootState
{
    /// Confidence that the sole is on the floor. It is 1 in a contact in which ankle and toe stand together,
    /// less if only one stands and hovers, and 0 outside of contacts.
    float landed = 0.0f;
    float settled = 0.0f;     ///< confidence that the foot has landed and hardly moves
    float aloft = 0.0f;       ///< confidence that the foot is still without standing
    float height = 0.0f;      ///< of the higher of ankle and toe
    float lowHeight = 0.0f;   ///< of the lower of the two
    float ankleHeight = 0.0f; ///< of the ankle
};

/// When a foot touches the floor.
struct FootTouches
{
    /// Frames in which the ankle or the toe stands, whatever the other does: for example, a heel that has
    /// come down or a ball that pushes off.
    std::vector<Contact> contacts;
    std::vector<Contact> flat;     ///< frames in which ankle and toe stand together
    std::vector<Contact> ankle;    ///< frames in which the ankle stands, whatever the toe does
    std::vector<Contact> toe;      ///< same for the toe; empty for a foot without one
    std::vector<FootState> states; ///< one per frame
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
    void FindLanded(const FloorPath& ankle, const FloorPath& toe, FootTouches& touches) const;
    FootTouches TouchesOf(const CLegTrack& leg, float ankleFloor, float toeFloor,
                          double secondsPerFrame) const;

    std::vector<CLegTrack> m_kLegs;
    double m_fLegLength = 0.0;
};

} // namespace gw
