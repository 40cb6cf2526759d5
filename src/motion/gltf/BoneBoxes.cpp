#include "BoneBoxes.h"

#include <algorithm>
#include <array>
#include <cmath>

namespace gw {

namespace {

constexpr float kWidthShare = 0.2f; // of the bone's length
constexpr size_t kCorners = 4;      // of a face

// The box's own axes: along the bone, and two perpendicular to it.
struct Axes
{
    std::array<Vec3, 3> half; // from the center to the faces
    Vec3 center;
};

Axes AxesOf(const BoneBox& bone, float mostWidth)
{
    const Vec3 along = bone.to - bone.from;
    const float length = static_cast<float>(Vec3Length(along));
    const float width = std::min(kWidthShare * length, mostWidth);
    const Vec3 other = std::fabs(along.x) < 0.5f * length ? kVec3UnitX : kVec3UnitZ;
    const Vec3 second = Vec3Normalized(Vec3Cross(along, other));
    const Vec3 third = Vec3Normalized(Vec3Cross(along, second));
    return {
        {along * 0.5f, second * (0.5f * width), third * (0.5f * width)},
        bone.from + along * 0.5f
    };
}

void AddVertex(BoxMesh& mesh, const Vec3& position, const Vec3& normal, uint16_t joint)
{
    mesh.positions.insert(mesh.positions.end(), {position.x, position.y, position.z});
    mesh.normals.insert(mesh.normals.end(), {normal.x, normal.y, normal.z});
    mesh.joints.insert(mesh.joints.end(), {joint, 0, 0, 0});
    mesh.weights.insert(mesh.weights.end(), {1.0f, 0.0f, 0.0f, 0.0f});
}

// Adds the face on one side of an axis. Its corners run counterclockwise around the outward normal.
void AddFace(BoxMesh& mesh, const Axes& axes, size_t axis, float sign, uint16_t joint)
{
    const Vec3 outward = axes.half[axis] * sign;
    const Vec3 u = axes.half[(axis + 1) % 3];
    const Vec3 v = axes.half[(axis + 2) % 3] * sign;
    const auto first = static_cast<uint32_t>(mesh.positions.size() / 3);
    const Vec3 normal = Vec3Normalized(outward);
    const std::array<Vec3, kCorners> corners = {u * -1.0f - v, u - v, u + v, v - u};
    for (const Vec3& corner : corners)
        AddVertex(mesh, axes.center + outward + corner, normal, joint);
    for (const uint32_t corner : {0u, 1u, 2u, 0u, 2u, 3u})
        mesh.indices.push_back(first + corner);
}

} // namespace

BoxMesh MakeBoneBoxes(const std::vector<BoneBox>& bones, float mostWidth)
{
    BoxMesh mesh;
    for (const BoneBox& bone : bones)
    {
        if (!(Vec3Length(bone.to - bone.from) > 0.0))
            continue;
        const Axes axes = AxesOf(bone, mostWidth);
        for (size_t axis = 0; axis < axes.half.size(); ++axis)
        {
            AddFace(mesh, axes, axis, 1.0f, bone.joint);
            AddFace(mesh, axes, axis, -1.0f, bone.joint);
        }
    }
    return mesh;
}

} // namespace gw
