#pragma once

#include "CMadeFigure.h"
#include "CRetargeter.h"

#include <array>
#include <functional>
#include <string>

namespace gw {

inline constexpr Vec3 kTargetOrigin{0.0f, 923.0f, 13.0f}; ///< of its root, at rest
inline constexpr float kWalkerSeconds = 1.0f / 30.0f;     ///< from frame to frame

/// A body in centimetres that is posed by where its hips and ankles are, so that a test knows which feet
/// stand and what its knees do. Its legs are 45 + 37 long; a flat foot's ankle is 8 above the floor.
class CWalker : public CMadeFigure
{
public:
    /// Left and right, in this order.
    struct Pose
    {
        Vec3 hips{0.0f, 84.0f, 0.0f}; ///< the middle of the hip joints
        std::array<Vec3, 2> ankles{Vec3{9.0f, 8.0f, 0.0f}, Vec3{-9.0f, 8.0f, 0.0f}};
        std::array<float, 2> footDegrees{0.0f, 0.0f}; ///< toes down
        float lean = 0.0f;                            ///< degrees of the pelvis about x, forward
        float kneesOut = 0.0f;                        ///< degrees of the knees' plane, outward
    };

    CWalker();
    /// Gives every joint a track of so many frames.
    void Record(int frameCount, const std::function<Pose(int frame)>& pose);

private:
    void PoseLeg(size_t side, const Pose& pose, const Mat3& pelvis);
};

/// A walk of 70 cm in 36 frames.
CWalker::Pose WalkingPose(int frame);
/// Whether the left (0) or right foot lies flat and still in a frame of that walk.
bool WalkerStands(int side, int frame);

/// A target of the fixed skeleton's make without a right arm: legs below pelvis bones that are turned by half
/// a turn, 360 + 345 long, soles on y = 0 at rest.
Ref<CNode> MakeTarget();
/// Pairs a walker with such a target, with the offsets that match their rest poses.
void PairWalker(CRetargeter& retargeter, const CWalker& walker, CNode& target);

} // namespace gw
