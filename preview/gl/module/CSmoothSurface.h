#pragma once

namespace gw {

/// A surface with several samples per pixel, next to the surface of the current context: what is drawn to it
/// has smooth edges. A GL that cannot do that draws to the context's own surface.
class CSmoothSurface
{
public:
    /// Needs a current context, which must outlive the object. Drawing goes to this surface from now on.
    CSmoothSurface(int width, int height);
    ~CSmoothSurface();
    CSmoothSurface(const CSmoothSurface&) = delete;
    CSmoothSurface& operator=(const CSmoothSurface&) = delete;

    /// Directs drawing to this surface.
    void Select() const;
    /// Copies the mean of the samples to the context's surface, which is then read.
    void Resolve() const;

private:
    int m_iWidth;
    int m_iHeight;
    unsigned m_uiFrame = 0; ///< 0 is the context's own surface
    unsigned m_uiPixels = 0;
};

} // namespace gw
