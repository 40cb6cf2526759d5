#pragma once

#include "RgbPicture.h"

namespace gw {

/// A GL context with its own surface and no display, whose pixels can be read back. It is current in the
/// thread that created it until it is destroyed; that thread must not have another current context.
class COffscreenContext
{
public:
    COffscreenContext() = default;
    ~COffscreenContext();
    COffscreenContext(const COffscreenContext&) = delete;
    COffscreenContext& operator=(const COffscreenContext&) = delete;

    /// Call once. Returns false if the machine's GL has no such contexts, or none with that many pixels.
    bool Create(int width, int height);
    /// Returns the lower left part of the surface, within the size passed to Create.
    RgbPicture ReadPixels(int width, int height) const;

private:
    // EGL handles are pointers; its headers are not included here.
    void* m_pkDisplay = nullptr;
    void* m_pkSurface = nullptr;
    void* m_pkContext = nullptr;
};

} // namespace gw
