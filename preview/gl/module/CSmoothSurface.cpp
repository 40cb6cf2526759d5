// GL_GLEXT_PROTOTYPES: framebuffer objects are part of GL 3.0, and exported by the library that is linked.
// A context with samples of its own would be simpler, but Mesa's software renderer leaks its buffers.
#define GL_GLEXT_PROTOTYPES

#include "CSmoothSurface.h"

#include <algorithm>

#include <GL/gl.h>
#include <GL/glext.h>

namespace gw {

namespace {

constexpr int kSamples = 4;                   // per pixel
constexpr int kMostSmoothPixels = 16'000'000; // above, the samples would take more than 256 MB

} // namespace

CSmoothSurface::CSmoothSurface(int width, int height) : m_iWidth(width), m_iHeight(height)
{
    GLint samples = 0;
    glGetIntegerv(GL_MAX_SAMPLES, &samples);
    if (samples < 2 || width * height > kMostSmoothPixels)
        return;
    glGenFramebuffers(1, &m_uiFrame);
    glGenRenderbuffers(1, &m_uiPixels);
    glBindFramebuffer(GL_FRAMEBUFFER, m_uiFrame);
    glBindRenderbuffer(GL_RENDERBUFFER, m_uiPixels);
    glRenderbufferStorageMultisample(GL_RENDERBUFFER, std::min(samples, kSamples), GL_RGBA8, width, height);
    glFramebufferRenderbuffer(GL_FRAMEBUFFER, GL_COLOR_ATTACHMENT0, GL_RENDERBUFFER, m_uiPixels);
    if (glCheckFramebufferStatus(GL_FRAMEBUFFER) == GL_FRAMEBUFFER_COMPLETE)
        return;
    glDeleteFramebuffers(1, &m_uiFrame); // binds the context's own surface
    m_uiFrame = 0;
}

CSmoothSurface::~CSmoothSurface()
{
    if (m_uiFrame != 0)
        glDeleteFramebuffers(1, &m_uiFrame);
    if (m_uiPixels != 0)
        glDeleteRenderbuffers(1, &m_uiPixels);
}

void CSmoothSurface::Select() const
{
    glBindFramebuffer(GL_FRAMEBUFFER, m_uiFrame);
}

void CSmoothSurface::Resolve() const
{
    if (m_uiFrame == 0)
        return;
    glBindFramebuffer(GL_READ_FRAMEBUFFER, m_uiFrame);
    glBindFramebuffer(GL_DRAW_FRAMEBUFFER, 0);
    glBlitFramebuffer(0, 0, m_iWidth, m_iHeight, 0, 0, m_iWidth, m_iHeight, GL_COLOR_BUFFER_BIT, GL_NEAREST);
    glBindFramebuffer(GL_FRAMEBUFFER, 0);
}

} // namespace gw
