#pragma once

namespace gw {

struct GLScene;

/// The surface that a view needs, in bits, in addition to two color buffers: no alpha, stencil, accumulation
/// or samples.
struct PixelFormat
{
    int redBits = 8;
    int greenBits = 8;
    int blueBits = 8;
    int depthBits = 16;
};
inline constexpr PixelFormat kPixelFormat;

// Each function needs a current context: version 2.1 or a compatibility profile, with no buffer object bound.

/// Call once per context. Sets flat shading and the clear color.
void InitGL();
/// Sets viewport and projection for a surface size. Sizes below 1 are ignored.
void ResizeGL(int width, int height);
/// Clears, draws a scene, and waits until it is done. The window swaps the buffers.
void PaintGL(const GLScene& scene);

} // namespace gw
