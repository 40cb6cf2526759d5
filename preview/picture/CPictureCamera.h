#pragma once

#include "Vec3.h"

#include <cstdint>

namespace gw {

/// The direction from which a figure is seen; relative to the way that it faces.
enum class EPictureView : uint8_t
{
    Front,
    Side, ///< from its right
    ThreeQuarter,
    Top,
};

/// Projects points along parallel lines, as on the pages about conversions.
class CPictureCamera
{
public:
    CPictureCamera() = default;
    /// `across` is a horizontal unit vector toward the figure's left.
    CPictureCamera(EPictureView view, const Vec3& across);

    /// Returns x to the right, y upward, and z toward the viewer, in the points' unit, relative to a point.
    Vec3 Project(const Vec3& point, const Vec3& center) const;

private:
    Vec3 m_kRight = kVec3UnitX;  ///< horizontal
    Vec3 m_kToward = kVec3UnitZ; ///< horizontal
    float m_fTiltSine = 0.0f;    ///< of the angle by which the camera looks down
    float m_fTiltCosine = 1.0f;
};

} // namespace gw
