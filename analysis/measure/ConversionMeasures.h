#pragma once

#include <cstddef>
#include <optional>
#include <string>
#include <vector>

namespace gw {

// What a conversion did to a motion, in figures. Frames are the source's; the result is sampled at the same
// instants. World space with y up on both sides. Angles are degrees. A length is given in the result's unit
// (mm) or, where source and result stand side by side, in leg lengths of its own skeleton: thigh to knee to
// ankle at frame 0, both legs' mean. A ratio is result by source and missing where the source's figure is 0
// but for rounding.

/// How one mapped bone points. The direction of a bone is that from its joint to the next joint below that is
/// not at the same place: towards the nearest mapped bone below, else along the branch that goes on farthest.
/// Where a bone branches into several mapped ones, the branch counts that leaves least sideways (x) in the
/// result's rest pose: the spine for a hip, the neck for a chest. Source and result each take a joint on the
/// way to the same mapped bone; where that bone's source is not below this bone's (a collar that drives the
/// torso), the source's direction begins where the two branch.
struct BoneMeasures
{
    std::string target;      ///< bone of the result
    std::string source;      ///< bone that drives it
    std::string targetChild; ///< the joint that the direction leads to; empty for an end joint
    std::string sourceChild; ///< the same in the source
    /// Both sides have a direction. An end joint (a head, a hand without fingers) has none, and all figures
    /// below are 0.
    bool measured = false;
    double meanError = 0.0;    ///< mean over all frames of the angle between the two directions
    double largestError = 0.0; ///< the largest of these angles
    int largestFrame = 0;      ///< where it stands, from 0 on
    /// Mean over the inner frames of |d(f - 1) - 2 d(f) + d(f + 1)|, d being the unit direction.
    double sourceJitter = 0.0;
    double resultJitter = 0.0; ///< the same for the result's bone
};

/// What one foot does: an ankle, and a toe joint where there is one. A side's foot stands in a frame when its
/// ankle and toe are near the floor and slow, with hysteresis (FindContacts.h). A contact is an unbroken run
/// of such frames. Both sides are looked at by the same rule, each in its own leg lengths.
struct FootMeasures
{
    std::string target; ///< ankle of the result
    std::string source; ///< ankle that drives it

    /// Turn: the angle about y from the source foot's heading to the result's, -180 to 180. A foot's heading
    /// is its direction from ankle to toe, seen from above; frames in which a foot points up or down within
    /// 30 degrees are left out. A foot without a toe joint heads along that axis of its own which lies along
    /// the other foot at frame 0, so that turns count from there: see `turnFromStart`.
    double turnMean = 0.0;          ///< signed mean over the frames; positive turns z towards x
    double turnError = 0.0;         ///< mean of its absolute value
    double turnLargest = 0.0;       ///< largest absolute value
    double turnWhileStanding = 0.0; ///< mean absolute value over the frames of the source's contacts
    bool turnFromStart = false;     ///< a side has no toe joint, and frame 0 counts as no turn

    /// Tilt: the angle between the sole's normal and y, over the frames of the source's contacts. The normal
    /// is the axis of the foot that is y in the skeleton's rest pose.
    double soleTiltMean = 0.0;
    double soleTiltLargest = 0.0;
    double sourceSoleTiltMean = 0.0; ///< the same of the source's foot

    /// Slide: the largest distance over the ground between the ankle at the start of a contact of the source
    /// and the ankle later in it. Added slide is the result's minus the source's, in leg lengths, and may be
    /// negative.
    double addedSlideMean = 0.0;         ///< mean over the contacts, mm
    double addedSlideLargest = 0.0;      ///< of one contact, mm
    int addedSlideFrame = 0;             ///< in which the result's ankle is farthest off in that contact
    double addedSlideMeanShare = 0.0;    ///< mean, in leg lengths
    double addedSlideLargestShare = 0.0; ///< largest, in leg lengths
    double sourceSlideShare = 0.0;       ///< mean slide of the source, in its leg lengths
    double resultSlideShare = 0.0;       ///< mean slide of the result, in its leg lengths

    size_t sourceContacts = 0; ///< number of contacts
    size_t resultContacts = 0; ///< the same in the result
    size_t sourceStanding = 0; ///< frames in contact
    size_t resultStanding = 0; ///< the same in the result
    size_t bothStanding = 0;   ///< frames in which both stand
    /// 2 both / (source + result), in frames: 1 where the same frames stand, missing where none stands.
    std::optional<double> contactF1;

    /// Knee: the angle between thigh and calf, 0 for a straight leg. A pop is a frame into which it changes
    /// by over 5 degrees more than the source's knee does.
    size_t kneePops = 0;
    std::vector<int> kneePopFrames; ///< which these are
    int kneePopFrame = 0;           ///< the frame of the next figure
    double kneePopLargest = 0.0; ///< most by which the change of one frame exceeds the source's; at least 0
    double kneeChangeLargest = 0.0; ///< largest change from one frame to the next
    double sourceKneeChangeLargest = 0.0;
};

/// All figures of one conversion.
struct ConversionMeasures
{
    int frameCount = 0;      ///< frames compared: those of the source up to the result's last
    double frameScale = 1.0; ///< frames of the result to one of the source
    double sourceLeg = 0.0;  ///< leg length, in the source's unit; 0 without a mapped leg
    double resultLeg = 0.0;  ///< leg length, in the result's unit

    std::vector<BoneMeasures> bones; ///< in the order of the pairs
    double meanError = 0.0;          ///< mean over all measured bones and frames
    double largestError = 0.0;       ///< largest of all

    double sourceJitter = 0.0; ///< mean over the measured bones
    double resultJitter = 0.0;
    std::optional<double> jitterRatio;

    std::vector<FootMeasures> feet; ///< those of LFoot and RFoot that are mapped
    /// 2 both / (source + result) over all feet.
    std::optional<double> contactF1;

    /// Where the result stands, against y = 0, mm: the median of a sole's height over the frames of the
    /// result's contacts, missing where it never stands. A sole is what lies on the floor under ankle and toe
    /// in the rest pose (RestFloor), and its height is that of its lower end.
    std::optional<double> floorHeight;
    /// 95th percentile over all frames of the depth of the lowest sole below y = 0, mm; 0 where it is not
    /// below.
    double sinkDepth = 0.0;

    /// Path over the ground (x and z) of the result's root and of its source bone, summed over the frames, in
    /// leg lengths; 0 where the root is not mapped.
    double sourceTravel = 0.0;
    double resultTravel = 0.0;
    std::optional<double> travelRatio;
};

} // namespace gw
