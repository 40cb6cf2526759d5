#pragma once

#include "Vec3.h"

#include <compare>
#include <cstddef>
#include <cstdint>
#include <span>
#include <vector>

namespace gw {

/// A selected normal of one of several meshes, and its position.
struct NormalPlace
{
    size_t m_uiMesh;     ///< which of the meshes
    uint32_t m_uiNormal; ///< index of the normal in that mesh
    Vec3 m_kPoint;       ///< in world space
    Vec3 m_kNormal;
};

/// Places sorted into cells slightly larger than a distance, so everything within that distance of a point is
/// in its own cell or a neighboring one.
class CPlaceGrid
{
public:
    /// With a distance of 0 or below, nothing is near anything.
    CPlaceGrid(std::span<const NormalPlace> places, float distance);

    /// Returns the sum of the normals of other meshes that are closer to this place than the distance.
    Vec3 SumNear(const NormalPlace& place) const;

private:
    struct Cell
    {
        int64_t x;
        int64_t y;
        int64_t z;
        auto operator<=>(const Cell&) const = default;
    };
    struct Entry
    {
        Cell cell;
        const NormalPlace* place;
    };

    Cell CellOf(const Vec3& point) const;
    // Sums the places in a range of cells, in order.
    Vec3 SumRun(const NormalPlace& place, const Cell& first, const Cell& last) const;

    double m_fDistance;
    std::vector<Entry> m_kEntries; // by cell; within a cell in the order of the places
};

} // namespace gw
