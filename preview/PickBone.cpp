// Finds the bone under the mouse: projects the edges of all meshes as they are drawn, and takes the nearest.

#include "PickBone.h"

#include "Angles.h"
#include "CTriMesh.h"
#include "GLScene.h"

#include <algorithm>
#include <cmath>
#include <optional>

namespace gw {

namespace {

constexpr double kReach = 6.0;        // pixels
constexpr double kNearest = 1.0;      // the near plane
constexpr double kJointPenalty = 2.0; // pixels: a shape at the same distance wins

struct Point
{
    double x;
    double y;
};

class CPicker
{
public:
    CPicker(const CEyeSpace& space, const ViewPosition& at) : m_kSpace(space), m_kAt(at) {}

    /// Returns a mesh's distance from the position, in pixels.
    double DistanceOf(CTriMesh& mesh) const
    {
        const auto joint = Projected(mesh.m_kWorldMatrix.Translation());
        double distance = joint ? Distance(*joint, *joint) + kJointPenalty : HUGE_VAL;
        const std::span<const Vec3> points = mesh.WorldXYZBuffer();
        const auto& corners = mesh.XYZTriIndexBuffer();
        for (size_t i = 0; i + 2 < corners.size(); i += 3)
        {
            for (size_t side = 0; side < 3; ++side)
            {
                const size_t from = corners[i + side];
                const size_t to = corners[i + (side + 1) % 3];
                if (std::max(from, to) < points.size()) // a file can refer to points that do not exist
                    distance = std::min(distance, EdgeDistance(points[from], points[to]));
            }
        }
        return distance;
    }

private:
    std::optional<Point> Projected(const Vec3& world) const
    {
        const Vec3 place = m_kSpace.PlaceOf(world);
        const double depth = -static_cast<double>(place.z);
        if (!(depth >= kNearest))
            return std::nullopt;
        const double scale = m_kAt.height / 2 / std::tan(kAngleOfView / 2 * kPi64 / 180.0) / depth;
        return Point{m_kAt.width / 2 + scale * place.x, m_kAt.height / 2 - scale * place.y};
    }

    double EdgeDistance(const Vec3& from, const Vec3& to) const
    {
        const auto a = Projected(from);
        const auto b = Projected(to);
        return a && b ? Distance(*a, *b) : HUGE_VAL;
    }

    // Returns the distance between the position and a line.
    double Distance(const Point& a, const Point& b) const
    {
        const double dx = b.x - a.x;
        const double dy = b.y - a.y;
        const double squared = dx * dx + dy * dy;
        const double along = squared > 0.0 ? ((m_kAt.x - a.x) * dx + (m_kAt.y - a.y) * dy) / squared : 0.0;
        const double share = std::clamp(along, 0.0, 1.0);
        return std::hypot(a.x + share * dx - m_kAt.x, a.y + share * dy - m_kAt.y);
    }

    const CEyeSpace& m_kSpace;
    ViewPosition m_kAt;
};

} // namespace

std::string PickBone(std::span<const Ref<CTriMesh>> meshes, const CEyeSpace& space, const ViewPosition& at)
{
    const CPicker picker(space, at);
    std::string found;
    double nearest = kReach;
    for (const Ref<CTriMesh>& mesh : meshes)
    {
        const CSpatial* const bone = mesh->GetParent();
        if (!bone)
            continue;
        const double distance = picker.DistanceOf(*mesh);
        if (!(distance < nearest))
            continue;
        nearest = distance;
        found = bone->NameView();
    }
    return found;
}

} // namespace gw
