// Neighbor search with a uniform grid, stored as a sorted list of (cell, point) instead of a hash map. All
// points within the distance are in the 3 x 3 x 3 cells around a point. The three cells along z follow each
// other in the list, so nine binary searches find them all.

#include "CPlaceGrid.h"

#include <algorithm>
#include <cmath>

namespace gw {

namespace {

// Rounding must not put two close points two cells apart.
constexpr double kCellsPerDistance = 1.01;

int64_t CellIndex(float coordinate, double distance)
{
    constexpr double kFarthest = 1e15;
    const double index = std::floor(static_cast<double>(coordinate) / (distance * kCellsPerDistance));
    return std::isnan(index) ? 0 : static_cast<int64_t>(std::clamp(index, -kFarthest, kFarthest));
}

} // namespace

CPlaceGrid::CPlaceGrid(std::span<const NormalPlace> places, float distance)
    : m_fDistance(static_cast<double>(distance))
{
    if (!(m_fDistance > 0.0))
        return;
    m_kEntries.reserve(places.size());
    for (const NormalPlace& place : places)
        m_kEntries.push_back({CellOf(place.m_kPoint), &place});
    std::ranges::stable_sort(m_kEntries, {}, &Entry::cell);
}

CPlaceGrid::Cell CPlaceGrid::CellOf(const Vec3& point) const
{
    return {CellIndex(point.x, m_fDistance), CellIndex(point.y, m_fDistance),
            CellIndex(point.z, m_fDistance)};
}

Vec3 CPlaceGrid::SumRun(const NormalPlace& place, const Cell& first, const Cell& last) const
{
    Vec3 sum = kVec3Zero;
    auto entry = std::ranges::lower_bound(m_kEntries, first, {}, &Entry::cell);
    for (; entry != m_kEntries.end() && entry->cell <= last; ++entry)
    {
        const NormalPlace& other = *entry->place;
        if (other.m_uiMesh != place.m_uiMesh && Vec3Length(place.m_kPoint - other.m_kPoint) < m_fDistance)
            sum = sum + other.m_kNormal;
    }
    return sum;
}

Vec3 CPlaceGrid::SumNear(const NormalPlace& place) const
{
    Vec3 sum = kVec3Zero;
    const Cell middle = CellOf(place.m_kPoint);
    for (int64_t x = middle.x - 1; x <= middle.x + 1; ++x)
    {
        // Neighboring cells along z form one run.
        for (int64_t y = middle.y - 1; y <= middle.y + 1; ++y)
            sum = sum + SumRun(place, {x, y, middle.z - 1}, {x, y, middle.z + 1});
    }
    return sum;
}

} // namespace gw
