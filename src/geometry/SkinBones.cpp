#include "SkinBones.h"

#include "CNode.h"

namespace gw {

CSpatial* CBonesByName::Find(const CSpatial* bone)
{
    if (!bone || !bone->GetName())
        return nullptr;
    const auto [known, isNew] = m_kFound.try_emplace(bone);
    if (isNew)
        known->second = static_cast<CNode*>(root_.FindObject(bone->GetName(), &CNode::ms_kRTTI, true));
    return known->second;
}

CCopies::CCopies(const CCloneMap& map)
{
    for (const auto& [id, copy] : map)
        m_kCopies.insert(copy);
}

} // namespace gw
