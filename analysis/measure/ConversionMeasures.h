#pragma once

#include <cstddef>
#include <optional>
#include <string>
#include <vector>

namespace gw {

// What a conversion did to a motion, in figures. Frames are the source's; the result is sampled at the same
// instants. World space with y up on both sides. Angles are degrees. A length is given in the result's unit
// (mm): one of the source is scaled by the ratio of the legs before it is compared, so that lengths are
// compared in leg lengths. A leg is thigh to knee to ankle at frame 0, both legs' mean. A ratio is result by
// source and missing where the source's figure is 0 but for rounding.

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
};

/// How far planted joints slide. A plant is an unbroken run of frames in which a joint of the source, the
/// ankle or the toe, is near the floor and slow, with hysteresis (FindContacts.h). Its slide is the largest
/// distance over the ground from where it was in the first frame. Added slide is the result's minus the
/// source's, mm, and negative where the result slides less.
struct SlideMeasures
{
    size_t plants = 0;
    double median = 0.0;  ///< added slide of the plants
    double largest = 0.0; ///< the largest one
    int largestFrame = 0; ///< in which the result's joint is farthest off in that plant
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

    SlideMeasures ankleSlide;
    SlideMeasures toeSlide; ///< without plants where a side has no toe joint

    size_t sourceContacts = 0; ///< number of contacts
    size_t resultContacts = 0; ///< the same in the result
    /// Frames in contact. Those in which ankle or toe of the source, whichever is faster, moves at 15 to 30
    /// cm/s do not count: nobody can tell whether such a foot stands.
    size_t sourceStanding = 0;
    size_t resultStanding = 0; ///< the same in the result
    size_t bothStanding = 0;   ///< frames in which both stand
    /// 2 both / (source + result), in frames: 1 where the same frames stand, missing where none stands.
    std::optional<double> contactF1;

    /// Held sole: how far the lower end of the result's sole is from the floor, y = 0, above or below, over
    /// the frames of the source's contacts, mm. A sole is what lies on the floor under ankle and toe in the
    /// rest pose (RestFloor).
    double heldSole = 0.0; ///< 95th percentile
    double heldSoleLargest = 0.0;
    int heldSoleFrame = 0; ///< the frame of the largest

    /// Knee: the angle between thigh and calf, 0 for a straight leg. A pop is a run of frames in which it
    /// changes within 1/30 s by over 5 degrees more than the source's largest change within 1/30 s, from 1/15
    /// s before to 1/15 s behind.
    size_t kneePops = 0;
    std::vector<int> kneePopFrames; ///< the worst frame of each
    int kneePopFrame = 0;           ///< the frame of the next figure
    double kneePopLargest = 0.0;    ///< most by which a change exceeds the source's; at least 0
};

/// What one hand does: the hand's joint, the wrist. It touches a thigh, the torso, the head, the other hand
/// or the floor in a frame in which the source's is within 50 mm of where it would lie on it.
struct HandMeasures
{
    std::string target; ///< hand of the result
    std::string source; ///< what drives it

    size_t touchFrames = 0; ///< in which the source's hand touches anything
    /// How much farther from a touched part, or nearer to it, the result's hand is than the source's, mm: the
    /// 95th percentile over the frames of the touch, of the part for which that is the most; missing where
    /// nothing is touched for 0.08 s.
    std::optional<double> gap;
    std::string gapPart;     ///< "thigh", "torso", "head", "other hand" or "floor"
    double gapLargest = 0.0; ///< largest of one frame, for that part
    int gapFrame = 0;
    double depth = 0.0; ///< how deep the result's hand is below y = 0 at most, mm
    int depthFrame = 0;
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

    /// Between source and result, the angle of the line from the middle of the hip joints to the neck, less
    /// the difference of the rest poses (MeasureTrunk.h). Missing without a mapped leg or neck.
    std::optional<double> trunkMean;
    std::optional<double> trunkMost; ///< 95th percentile
    int trunkFrame = 0;              ///< the frame of the next figure
    double trunkLargest = 0.0;

    /// Jitter of the directions of thighs and calves at 30 Hz (LegJitter.h), the result's by the source's.
    std::optional<double> jitterRatio;        ///< median over these bones
    std::optional<double> jitterRatioLargest; ///< of one bone

    std::vector<FootMeasures> feet; ///< those of LFoot and RFoot that are mapped
    SlideMeasures ankleSlide;       ///< over the plants of all feet
    SlideMeasures toeSlide;
    std::optional<double> contactF1; ///< over all feet
    std::optional<double> heldSole;  ///< over the contacts of all feet; missing where the source never stands
    /// 95th percentile over all frames of the depth of the lowest sole below y = 0, mm; 0 where it is not
    /// below.
    double sinkDepth = 0.0;

    std::vector<HandMeasures> hands; ///< those of LHand and RHand that are mapped, where a leg is
    std::optional<double> handGap;   ///< the larger one of the hands
    std::optional<double> handDepth; ///< the larger one; missing without hands

    /// Path over the ground (x and z) of the middle of the hip joints, summed over the frames, in leg
    /// lengths; 0 without a mapped leg.
    double sourceTravel = 0.0;
    double resultTravel = 0.0;
    std::optional<double>
        travelRatio; ///< missing where the source's path is below 50 cm in the result's size
};

} // namespace gw
