#pragma once

#include "CControl.h"
#include "CGLView.h"
#include "CTriMesh.h"

#include <vector>

namespace gw {

/// A control that changes nothing and notes the times at which its target was evaluated.
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

/// A root with a bound of its own, which lasts until the scene is evaluated.
Ref<CNode> MakeScene(const BoundSphere& bound);
/// Attaches a keeper to a scene; the scene owns it.
CTimeKeeper& AttachKeeper(CNode& root);
/// Attaches a named bone to a node, at a place in it, and a mesh to the bone. The mesh has separate
/// triangles, the i-th one moved by i along Z.
CTriMesh& AttachBone(CNode& parent, const char* name, int32_t triangles, const Vec3& place = kVec3Zero);

/// A view that counts how often it asks to be drawn.
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
