#pragma once

#include "Vec3.h"

#include <compare>
#include <cstddef>
#include <cstdint>
#include <span>
#include <vector>

namespace gw {

/// A selected normal of one of several meshes, with the place where it stands.
struct NormalPlace
{
    size_t m_uiMesh;     ///< which of the meshes
    uint32_t m_uiNormal; ///< index of the normal in it
    Vec3 m_kPoint;       ///< in the world
    Vec3 m_kNormal;
};

/// Places sorted into cells that are a little wider than the distance asked for, so that what is near lies in
/// the cell of a point or in one beside it.
class CPlaceGrid
{
public:
    /// Below or at 0 nothing is ever near.
    CPlaceGrid(std::span<const NormalPlace> places, float distance);

    /// The sum of the normals of other meshes whose places are nearer to this one than the distance.
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
    // Of the cells from one to another, in their order.
    Vec3 SumRun(const NormalPlace& place, const Cell& first, const Cell& last) const;

    double m_fDistance;
    std::vector<Entry> m_kEntries; // by cell, within a cell in the order of the places
};

} // namespace gw
