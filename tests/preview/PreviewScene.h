#pragma once

#include "CControl.h"
#include "CGLView.h"
#include "CTriMesh.h"

#include <vector>

namespace gw {

/// A control that changes nothing and records the times of its target's updates.
class CTimeKeeper : public CControl
{
public:
    bool UpdateTransform(float) override { return false; }
    bool Update(float time) override
    {
        m_kTimes.push_back(time);
        return true;
    }

    std::vector<float> m_kTimes;
};

/// Returns a root with a given bound, which lasts until the scene is updated.
Ref<CNode> MakeScene(const BoundSphere& bound);
/// Attaches a recorder to a scene, which owns it.
CTimeKeeper& AttachKeeper(CNode& root);
/// Attaches a named bone to a node, at a position, and a mesh to the bone. The mesh has separate triangles,
/// the i-th one moved by i along Z.
CTriMesh& AttachBone(CNode& parent, const char* name, int32_t triangles, const Vec3& place = kVec3Zero);

/// A view that counts its repaint requests.
class CCountedView : public CGLView
{
public:
    CCountedView()
    {
        SetRepaint([this] { ++m_iRepaints; });
    }

    int m_iRepaints = 0;
};

} // namespace gw
