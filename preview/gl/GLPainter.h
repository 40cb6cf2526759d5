#pragma once

namespace gw {

struct GLScene;

/// What a view asks of its surface, in bits, beside two colour buffers: no alpha, stencil, accumulation or
/// samples.
struct PixelFormat
{
    int redBits = 8;
    int greenBits = 8;
    int blueBits = 8;
    int depthBits = 16;
};
inline constexpr PixelFormat kPixelFormat;

// Each call wants a current context: version 2.1 or a compatibility profile, with no buffer object bound.

/// Once for each context: flat shading and the clear colour.
void InitGL();
/// Viewport and projection for a surface of that many pixels. Below 1 both stay as they were.
void ResizeGL(int width, int height);
/// Clears and draws a scene, and waits until that is done. Swapping buffers is the window's.
void PaintGL(const GLScene& scene);

} // namespace gw
