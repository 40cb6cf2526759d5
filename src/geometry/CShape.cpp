#include "CShape.h"

#include "CFieldArchive.h"

#include <algorithm>
#include <array>

namespace gw {

const CRTTI CShape::ms_kRTTI{"CShape", &CGeometry::ms_kRTTI};
const CRTTI CLine::ms_kRTTI{"CLine", &CShape::ms_kRTTI};
const CRTTI CCircle::ms_kRTTI{"CCircle", &CShape::ms_kRTTI};
const CRTTI CRectangle::ms_kRTTI{"CRectangle", &CShape::ms_kRTTI};

namespace {

constexpr double kLineReach = 5.0; // world units

Vec3 Mean(std::span<const Vec3> points)
{
    Vec3 sum = kVec3Zero;
    for (const Vec3& point : points)
        sum = sum + point;
    return points.empty() ? sum : sum * (1.0f / static_cast<float>(points.size()));
}

} // namespace

void CShape::GetCenter(Vec3& center)
{
    center = Mean(XYZBuffer());
}

void CShape::GetWorldCenter(Vec3& center)
{
    center = Mean(WorldXYZBuffer());
}

bool CLine::HitTest(const Vec3& worldPoint)
{
    const std::span<const Vec3> points = WorldXYZBuffer();
    if (points.size() < 2)
        return false;
    const Vec3 a = worldPoint - points[0];
    const Vec3 d = points[1] - points[0];
    const double length = Vec3Length(d);
    if (!(Vec3Length(a) * length > 0.0))
        return false;
    const double t = Vec3Dot(a, d) / length;
    if (t <= 0.0 || t >= length)
        return false;
    const Vec3 foot = points[0] + d * static_cast<float>(t / length);
    return Vec3Length(worldPoint - foot) < kLineReach;
}

void CCircle::Fields(CFieldArchive& archive)
{
    CShape::Fields(archive);
    archive.Float("m_fRadius", m_fRadius);
}

uint64_t CCircle::GetMemoryUsed() const
{
    return CShape::GetMemoryUsed() + 4;
}

bool CCircle::HitTest(const Vec3& worldPoint)
{
    const std::span<const Vec3> points = WorldXYZBuffer();
    return !points.empty() && Vec3Length(worldPoint - points[0]) <= static_cast<double>(m_fRadius);
}

bool CRectangle::HitTest(const Vec3& worldPoint)
{
    const std::span<const Vec3> points = WorldXYZBuffer();
    if (points.size() < 4)
        return false;
    std::array<float, 4> turns;
    for (size_t i = 0; i < turns.size(); ++i)
        turns[i] = Vec3Cross(points[i] - worldPoint, points[(i + 1) % 4] - worldPoint).z;
    return std::ranges::all_of(turns, [](float turn) { return turn > 0.0f; }) ||
           std::ranges::all_of(turns, [](float turn) { return turn < 0.0f; });
}

} // namespace gw
