#pragma once

#include "Vec3.h"

#include <string>

namespace gw {

class CNode;
class CRetargeter;

/// The interface of a bone map: which source bone drives which target bone. The default implementations do
/// nothing; the profile editor overrides them. Scenes are not kept alive.
class CBoneMapProfile
{
public:
    virtual ~CBoneMapProfile() = default;

    virtual void GetProfileName(std::string& name) const { name = m_kProfileName; }
    /// Each stores a root, if it is not null, and returns whether it did.
    virtual bool SetSourceScene(CNode* root) { return Store(m_pkSourceScene, root); }
    virtual bool SetTargetScene(CNode* root) { return Store(m_pkTargetScene, root); }
    virtual bool SetResultScene(CNode* root) { return Store(m_pkResultScene, root); }
    /// Stores the name of the bone selected in a tree; returns false with an empty name if none is.
    virtual bool GetSelectedSourceBone(std::string&) const { return true; }
    virtual bool GetSelectedTargetBone(std::string&) const { return true; }
    virtual bool LoadProfile(const std::string&) { return true; }
    virtual bool Reserved() { return true; }
    /// Counts the mapping rows of a profile file whose bones both exist, and all rows.
    virtual bool CountMatches(const std::string&, int*, int*) { return true; }
    /// Fills a retargeter's tables, or with null only marks the mapped bones. Returns false if a row did not
    /// fit.
    virtual bool ApplyProfile(CRetargeter*, int*, int*) { return true; }
    /// Returns whether any row drives the target's root bone.
    virtual bool HasRootMapping() const { return true; }
    virtual void GetRootOffset(Vec3& offset) const { offset = m_kRootOffset; }
    /// Returns the frame rate in frames per second.
    virtual int GetFrameRate() const { return m_iFrameRate; }
    virtual void PromptSaveChanges() {}

protected:
    static bool Store(CNode*& scene, CNode* root)
    {
        if (root)
            scene = root;
        return root != nullptr;
    }

    std::string m_kProfilePath;
    std::string m_kProfileName; ///< at most 64 characters
    CNode* m_pkSourceScene = nullptr;
    CNode* m_pkTargetScene = nullptr;
    CNode* m_pkResultScene = nullptr;
    Vec3 m_kRootOffset = kVec3Zero;
    int m_iFrameRate = 30;
};

} // namespace gw
