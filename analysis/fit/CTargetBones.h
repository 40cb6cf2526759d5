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
    /// From the bone's space to the world; the identity for a bone that is not there.
    Mat3 RestTurn(std::string_view bone) const;
    /// The unit direction from a bone to its first child, in the bone's space; +Y where there is none.
    Vec3 ChildAxis(std::string_view bone) const;

private:
    CBoneNames m_kNames;
};

} // namespace gw
