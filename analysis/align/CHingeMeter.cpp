#include "CHingeMeter.h"

#include "BodyPose.h"

namespace gw {

namespace {

// Sine of the minimum bend, 20 degrees: joints placed beside the bones' real ends bend a straight limb by
// half as much.
constexpr double kLeastSine = 0.34;
constexpr int kLeastFrames = 5;
// Minimum length of the mean of the axes, relative to that of identical axes: they lie within 35 degrees.
constexpr double kAgreement = 0.8;

} // namespace

void CHingeMeter::Add(const Vec3& upper, const Vec3& lower, const CNode& bone)
{
    const Vec3 axis = Vec3Cross(Vec3Normalized(upper), Vec3Normalized(lower));
    const double sine = Vec3Length(axis);
    if (!(sine >= kLeastSine))
        return;
    m_kSum = m_kSum + LocalDirection(axis, bone);
    m_fWeight += sine;
    ++m_iFrames;
}

std::optional<Vec3> CHingeMeter::Axis() const
{
    if (m_iFrames < kLeastFrames || Vec3Length(m_kSum) < kAgreement * m_fWeight)
        return std::nullopt;
    return Vec3Normalized(m_kSum);
}

} // namespace gw
