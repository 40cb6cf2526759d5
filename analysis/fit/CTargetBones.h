#pragma once

#include "FindBone.h"
#include "Mat3.h"
#include "Vec3.h"

#include <string_view>

namespace gw {

/// The bones of the target skeleton in its rest pose.
class CTargetBones
{
public:
    explicit CTargetBones(CNode& root) : m_kNames(&root) {}

    bool Has(std::string_view bone) const { return m_kNames.Find(bone) != nullptr; }
    /// Returns the rotation from the bone's space to world space; the identity if the bone does not exist.
    Mat3 RestTurn(std::string_view bone) const;
    /// Returns the unit direction from a bone to its first child, in the bone's space; +Y without a child.
    Vec3 ChildAxis(std::string_view bone) const;

private:
    CBoneNames m_kNames;
};

} // namespace gw
