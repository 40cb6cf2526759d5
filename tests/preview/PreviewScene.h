#pragma once

#include "CControl.h"
#include "CGLView.h"
#include "CTriMesh.h"
#include "RgbPicture.h"

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

/// Part of a picture, between the first two and the last two numbers.
struct PixelArea
{
    int left;
    int top;
    int right;
    int bottom;
};

/// Returns the number of pixels in an area with exactly this color.
inline int CountColor(const RgbPicture& picture, LineColor color, const PixelArea& area)
{
    int count = 0;
    for (int y = area.top; y < area.bottom; ++y)
    {
        for (int x = area.left; x < area.right; ++x)
        {
            const uint8_t* const pixel = picture.Pixel(x, y);
            count += LineColor{pixel[0], pixel[1], pixel[2]} == color ? 1 : 0;
        }
    }
    return count;
}

inline int CountColor(const RgbPicture& picture, LineColor color)
{
    return CountColor(picture, color, {0, 0, picture.width, picture.height});
}

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
