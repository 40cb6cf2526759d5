#pragma once

#include "CNode.h"

#include <functional>
#include <span>
#include <string>

namespace gw {

/// A bone of a figure's table. Parents stand before their children; the first row is the root.
struct MadeBone
{
    const char* name;
    const char* parent;
    Vec3 offset;           ///< from the parent, in its space
    double degreesZ = 0.0; ///< about Z at rest, against the parent
};

/// A body that tests build from a table of bones and move by a function of the frame.
class CMadeFigure
{
public:
    /// What was recorded, for the record that a room has of a motion.
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

    /// A person with the target skeleton's names: hips at 900 mm, legs of 400 + 400 mm straight down, feet
    /// that point along +z, a spine, a neck and arms that stretch sideways. At rest the soles lie on y = 0.
    /// `unit` is the number of units in a millimetre: 0.001 for a figure in metres.
    explicit CMadeFigure(double unit = 1.0);
    explicit CMadeFigure(std::span<const MadeBone> bones, double unit = 1.0);

    CNode& Root() const { return *m_spkRoot; }
    bool HasBone(const std::string& name) const;
    CNode& Bone(const std::string& name) const;
    /// Hangs a new bone under another one, or makes it the root.
    CNode& AddBone(const std::string& name, const std::string& parent, const Vec3& offset,
                   double degreesZ = 0.0);
    /// Takes a bone away with all below: without "LToe" and "RToe" feet have no toes.
    void Remove(const std::string& name);

    // Poses of the frame that is being recorded; each frame starts from the rest pose.
    /// Turns a bone about an axis by degrees.
    void Turn(const std::string& name, const Vec3& axis, double degrees);
    /// Moves a bone in its parent's space, in the table's unit.
    void Move(const std::string& name, const Vec3& offset);

    /// Makes tracks of `frameCount` keys: the pose function is called for each frame on the figure at rest.
    Recorded Record(int frameCount, const std::function<void(CMadeFigure&, int frame)>& pose,
                    float frequency = 1.0f / 30.0f);

private:
    Ref<CNode> m_spkRoot;
    float m_fUnit;
};

} // namespace gw
