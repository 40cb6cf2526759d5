#include "CPictureCamera.h"

#include "Angles.h"

#include <cmath>

namespace gw {

namespace {

struct ViewRow
{
    double turn; ///< from the front toward the figure's right, in degrees
    double tilt; ///< downward, in degrees
};

// Indexed by EPictureView; the same as in Player.js.
constexpr ViewRow kViews[] = {
    {0.0,  8.0 },
    {90.0, 8.0 },
    {40.0, 14.0},
    {0.0,  90.0},
};

} // namespace

CPictureCamera::CPictureCamera(EPictureView view, const Vec3& across)
{
    const ViewRow& row = kViews[static_cast<size_t>(view)];
    const auto sine = static_cast<float>(std::sin(row.turn * kDegreesToRadians64));
    const auto cosine = static_cast<float>(std::cos(row.turn * kDegreesToRadians64));
    m_kRight = across * cosine + Vec3Cross(across, kVec3UnitY) * sine;
    m_kToward = Vec3Cross(m_kRight, kVec3UnitY);
    m_fTiltSine = static_cast<float>(std::sin(row.tilt * kDegreesToRadians64));
    m_fTiltCosine = static_cast<float>(std::cos(row.tilt * kDegreesToRadians64));
}

Vec3 CPictureCamera::Project(const Vec3& point, const Vec3& center) const
{
    const Vec3 offset = point - center;
    const auto right = static_cast<float>(Vec3Dot(offset, m_kRight));
    const auto toward = static_cast<float>(Vec3Dot(offset, m_kToward));
    return {right, offset.y * m_fTiltCosine - toward * m_fTiltSine,
            toward * m_fTiltCosine + offset.y * m_fTiltSine};
}

} // namespace gw
