#pragma once

#include "CNode.h"

#include <functional>
#include <span>
#include <string>

namespace gw {

/// A bone in a figure's table. Parents come before their children; the first row is the root.
struct MadeBone
{
    const char* name;
    const char* parent;
    Vec3 offset;           ///< from the parent, in the parent's space
    double degreesZ = 0.0; ///< about Z at rest, relative to the parent
};

/// A body that tests build from a table of bones and animate by a function of the frame.
class CMadeFigure
{
public:
    /// The recorded motion, from which a test fills its room's own record.
    struct Recorded
    {
        CNode* root;
        float frequency;
        int frameCount;

        template <class Clip>
        operator Clip() const
        {
            return {root, frequency, frameCount};
        }
    };

    /// Creates a person with the target skeleton's names: hips at 900 mm, legs of 400 + 400 mm straight down,
    /// feet pointing along +z, a spine, a neck, and arms stretched sideways. At rest the soles are at y = 0.
    /// `unit` is the number of units per millimeter: 0.001 for a figure in meters.
    explicit CMadeFigure(double unit = 1.0);
    explicit CMadeFigure(std::span<const MadeBone> bones, double unit = 1.0);

    CNode& Root() const { return *m_spkRoot; }
    bool HasBone(const std::string& name) const;
    CNode& Bone(const std::string& name) const;
    /// Adds a bone below another one, or as the root.
    CNode& AddBone(const std::string& name, const std::string& parent, const Vec3& offset,
                   double degreesZ = 0.0);
    /// Gives a bone the mesh that the reader of BVH files would; `end` is that of a bone without children.
    void AddMesh(const std::string& name, const Vec3& end);
    /// Removes a bone with its subtree: without "LToe" and "RToe", feet have no toes.
    void Remove(const std::string& name);

    // Pose the frame being recorded; each frame starts from the rest pose.
    /// Rotates a bone about an axis by degrees.
    void Turn(const std::string& name, const Vec3& axis, double degrees);
    /// Moves a bone in its parent's space, in the table's unit.
    void Move(const std::string& name, const Vec3& offset);

    /// Records tracks of `frameCount` keys: for each frame, the pose function is called with the figure at
    /// rest.
    Recorded Record(int frameCount, const std::function<void(CMadeFigure&, int frame)>& pose,
                    float frequency = 1.0f / 30.0f);

private:
    Ref<CNode> m_spkRoot;
    float m_fUnit;
};

} // namespace gw
