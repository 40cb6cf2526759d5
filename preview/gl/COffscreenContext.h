#pragma once

#include "RgbPicture.h"

namespace gw {

/// A GL context with a surface of its own and no display: what is drawn can be read back. It is current in
/// the thread that created it, until its end; the thread must have no other one current.
class COffscreenContext
{
public:
    COffscreenContext() = default;
    ~COffscreenContext();
    COffscreenContext(const COffscreenContext&) = delete;
    COffscreenContext& operator=(const COffscreenContext&) = delete;

    /// Once. False where the machine's GL has no such contexts, or none of that many pixels.
    bool Create(int width, int height);
    /// The lower left part of the surface; a size within that of Create.
    RgbPicture ReadPixels(int width, int height) const;

private:
    // The handles of EGL are pointers; its headers stay out of this one.
    void* m_pkDisplay = nullptr;
    void* m_pkSurface = nullptr;
    void* m_pkContext = nullptr;
};

} // namespace gw
