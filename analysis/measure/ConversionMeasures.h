#pragma once

#include <cstddef>
#include <optional>
#include <string>
#include <vector>

namespace gw {

// The measurements of a conversion. Frames are those of the source, and the result is sampled at the same
// instants. World space has y up on both sides. Angles are in degrees. Lengths are in the result's unit (mm):
// source lengths are scaled by the ratio of the leg lengths before they are compared. The leg length is thigh
// to knee to ankle at frame 0, averaged over both legs. Ratios are result divided by source, and are missing
// if the source's value is 0 except for rounding.

/// How well one mapped bone keeps its direction. A bone's direction points from its joint to the next joint
/// below that is not at the same position: toward the nearest mapped bone below, otherwise along the longest
/// branch. If a bone branches into several mapped ones, the branch that deviates least sideways (x) in the
/// result's rest pose is used: the spine for a hip, the neck for a chest. Source and result each use a joint
/// on the path to the same mapped bone; a limb skips the source's twist joints and leads to that bone itself.
/// If that bone's source is not below this bone's source (a collar that drives the torso), the source's
/// direction starts where the two branch.
struct BoneMeasures
{
    std::string target;      ///< bone of the result
    std::string source;      ///< bone that drives it
    std::string targetChild; ///< joint at the end of the direction; empty for an end joint
    std::string sourceChild; ///< same in the source
    /// Whether both sides have a direction. An end joint (a head, a hand without fingers) has none; all
    /// figures below are then 0.
    bool measured = false;
    double meanError = 0.0;    ///< mean angle between the two directions over all frames
    double largestError = 0.0; ///< largest of these angles
    int largestFrame = 0;      ///< its frame, starting at 0
};

/// How far planted joints slide. A plant is an unbroken run of frames in which a source joint, ankle or toe,
/// is near the floor and slow, with hysteresis (FindContacts.h). Its slide is the largest distance over the
/// ground from its position in the first frame. Added slide is the result's slide minus the source's, in mm;
/// it is negative if the result slides less.
struct SlideMeasures
{
    size_t plants = 0;
    double median = 0.0;  ///< median added slide of the plants
    double largest = 0.0; ///< largest added slide
    int largestFrame = 0; ///< frame in which the result's joint is farthest off in that plant
};

/// What one foot does: an ankle, and a toe joint if there is one. A foot stands in a frame if its ankle and
/// toe are near the floor and slow, with hysteresis (FindContacts.h). A contact is an unbroken run of such
/// frames. The same rule applies to both sides, each in its own leg lengths.
struct FootMeasures
{
    std::string target; ///< ankle of the result
    std::string source; ///< ankle that drives it

    /// Turn: the angle about y from the source foot's heading to the result's, -180 to 180. A foot's heading
    /// is its direction from ankle to toe, seen from above; frames in which a foot is within 30 degrees of
    /// vertical are left out. For a foot without a toe joint, the heading is the foot's own axis that is
    /// parallel to the other side's foot at frame 0, so turns are relative to that frame: see
    /// `turnFromStart`.
    double turnMean = 0.0;          ///< signed mean over the frames; positive from z toward x
    double turnError = 0.0;         ///< mean of the absolute value
    double turnLargest = 0.0;       ///< largest absolute value
    double turnWhileStanding = 0.0; ///< mean absolute value over the frames in contact in the source
    bool turnFromStart = false;     ///< one side has no toe joint, so turns are relative to frame 0

    /// Tilt: the angle between the sole's normal and y, over the frames in contact in the source. The normal
    /// is the axis of the foot that is y in the skeleton's rest pose.
    double soleTiltMean = 0.0;
    double soleTiltLargest = 0.0;
    double sourceSoleTiltMean = 0.0; ///< same for the source's foot

    SlideMeasures ankleSlide;
    SlideMeasures toeSlide; ///< no plants if a side has no toe joint

    size_t sourceContacts = 0; ///< number of contacts
    size_t resultContacts = 0; ///< same in the result
    /// Numbers of frames in contact. Frames in which the faster of the source's ankle and toe moves at 15 to
    /// 30 cm/s do not count, because it is unclear whether such a foot stands.
    size_t sourceStanding = 0;
    size_t resultStanding = 0; ///< same in the result
    size_t bothStanding = 0;   ///< frames in which both stand
    /// 2 both / (source + result), in frames: 1 if the same frames stand, missing if none stands.
    std::optional<double> contactF1;

    /// Held sole: the distance of the lower end of the result's sole from the floor, y = 0, above or below,
    /// over the frames in contact in the source, in mm. The sole is the points on the floor under ankle and
    /// toe in the rest pose (RestFloor).
    std::optional<double> heldSole; ///< 95th percentile; missing if the source's foot never stands
    std::optional<double> heldSoleLargest;
    int heldSoleFrame = 0; ///< frame of the largest distance

    /// Knee: the angle between thigh and calf, 0 for a straight leg. A pop is a run of frames in which this
    /// angle changes within 1/30 s by over 5 degrees more than the source's largest change within 1/30 s, in
    /// a window from 1/15 s before to 1/15 s after.
    size_t kneePops = 0;
    std::vector<int> kneePopFrames; ///< worst frame of each pop
    int kneePopFrame = 0;           ///< frame of the next figure
    double kneePopLargest = 0.0;    ///< largest excess of a change over the source's; at least 0
};

/// What one hand does, measured at its joint, the wrist. It touches a thigh, the torso, the head, the other
/// hand or the floor in the frames in which the source's wrist is within 50 mm of where it would lie on that
/// part.
struct HandMeasures
{
    std::string target; ///< hand of the result
    std::string source; ///< bone that drives it

    size_t touchFrames = 0; ///< frames in which the source's hand touches anything
    /// How much farther from a touched part, or nearer to it, the result's hand is than the source's, in mm.
    /// This is the 95th percentile over the frames of the touch, for the part with the largest value. Missing
    /// if no touch lasts 0.08 s.
    std::optional<double> gap;
    std::string gapPart;     ///< "thigh", "torso", "head", "other hand" or "floor"
    double gapLargest = 0.0; ///< largest gap in one frame, for that part
    int gapFrame = 0;
    double depth = 0.0; ///< largest depth of the result's hand below y = 0, mm
    int depthFrame = 0;
};

/// All figures of one conversion.
struct ConversionMeasures
{
    int frameCount = 0;      ///< compared frames: those of the source up to the result's last one
    double frameScale = 1.0; ///< result frames per source frame
    double sourceLeg = 0.0;  ///< leg length, in the source's unit; 0 without a mapped leg
    double resultLeg = 0.0;  ///< leg length, in the result's unit

    std::vector<BoneMeasures> bones; ///< in pair order
    double meanError = 0.0;          ///< mean over all measured bones and frames
    double largestError = 0.0;       ///< largest error of all

    /// Angle between source and result of the line from the midpoint of the hip joints to the neck, without
    /// the difference between the rest poses (MeasureTrunk.h). Missing without a mapped leg or neck.
    std::optional<double> trunkMean;
    std::optional<double> trunkMost; ///< 95th percentile
    int trunkFrame = 0;              ///< frame of the next figure
    double trunkLargest = 0.0;

    /// Jitter of the directions of thighs and calves at 30 Hz (LegJitter.h): result divided by source.
    std::optional<double> jitterRatio;        ///< median over these bones
    std::optional<double> jitterRatioLargest; ///< largest ratio of a single bone

    std::vector<FootMeasures> feet; ///< LFoot and RFoot, if mapped
    SlideMeasures ankleSlide;       ///< over the plants of all feet
    SlideMeasures toeSlide;
    std::optional<double> contactF1; ///< over all feet
    std::optional<double> heldSole;  ///< over the contacts of all feet; missing if the source never stands
    /// 95th percentile over all frames of the lowest sole's depth below y = 0, in mm; 0 if it is not below.
    double sinkDepth = 0.0;

    std::vector<HandMeasures> hands; ///< LHand and RHand, if mapped; none without a mapped leg
    std::optional<double> handGap;   ///< larger of the two hands' gaps
    std::optional<double> handDepth; ///< larger of the two depths; missing without hands

    /// Length of the path over the ground (x and z) of the midpoint of the hip joints over all frames, in leg
    /// lengths; 0 without a mapped leg.
    double sourceTravel = 0.0;
    double resultTravel = 0.0;
    std::optional<double> travelRatio; ///< missing if the source's path is below 50 cm in the result's size
};

} // namespace gw
