#pragma once

#include "Vec3.h"

#include <functional>
#include <string>
#include <vector>

namespace gw {

/// A joint in the text of a BVH file. Parents come before their children.
struct TextJoint
{
    std::string name;
    int parent = -1; ///< -1 for the root
    Vec3 offset;
    Vec3 tip{0.0f, 6.0f, 0.0f}; ///< of a joint without children
    bool hasPositions = false;  ///< six channels; always true for the root
};

/// The values of a joint in a row.
struct TextKey
{
    Vec3 position;
    Vec3 degrees; ///< about X, Y and Z; written as rotations about Z, X and Y
};

/// Writes BVH files of made figures.
class CMadeText
{
public:
    explicit CMadeText(std::vector<TextJoint> joints) : m_kJoints(std::move(joints)) {}

    /// Returns a text with that many frames; `key` is called once per frame and joint.
    std::string Write(int frameCount, double frameSeconds,
                      const std::function<TextKey(size_t joint, int frame)>& key);

    bool m_bScientific = false; ///< writes numbers like 9.0000000e+01

private:
    void Line(size_t depth, const std::string& words);
    std::string Number(double number) const;
    std::string Numbers(const Vec3& v) const;
    void AddJoint(size_t joint, size_t depth);

    std::vector<TextJoint> m_kJoints;
    std::vector<size_t> m_kOrder; // order of the columns: depth first
    std::string m_kText;
};

} // namespace gw
