#include "COffscreenContext.h"

#include "GLPainter.h"

#include <EGL/egl.h>
#include <EGL/eglext.h>
#include <GL/gl.h>

#include <algorithm>

namespace gw {

namespace {

// Returns a display without a screen, or null. It is shared by the whole process: other contexts may still
// use it when one ends, so it is never terminated.
EGLDisplay OpenDisplay()
{
    EGLDisplay display = eglGetPlatformDisplay(EGL_PLATFORM_SURFACELESS_MESA, nullptr, nullptr);
    return display && eglInitialize(display, nullptr, nullptr) ? display : nullptr;
}

EGLConfig ChooseConfig(EGLDisplay display)
{
    const EGLint wanted[] = {
        EGL_SURFACE_TYPE, EGL_PBUFFER_BIT,       EGL_RENDERABLE_TYPE, EGL_OPENGL_BIT,
        EGL_RED_SIZE,     kPixelFormat.redBits,  EGL_GREEN_SIZE,      kPixelFormat.greenBits,
        EGL_BLUE_SIZE,    kPixelFormat.blueBits, EGL_DEPTH_SIZE,      kPixelFormat.depthBits,
        EGL_NONE};
    EGLConfig config = nullptr;
    EGLint count = 0;
    return eglChooseConfig(display, wanted, &config, 1, &count) && count > 0 ? config : nullptr;
}

} // namespace

bool COffscreenContext::Create(int width, int height)
{
    m_pkDisplay = OpenDisplay();
    if (!m_pkDisplay || !eglBindAPI(EGL_OPENGL_API))
        return false;
    EGLConfig config = ChooseConfig(m_pkDisplay);
    if (!config)
        return false;
    const EGLint size[] = {EGL_WIDTH, width, EGL_HEIGHT, height, EGL_NONE};
    m_pkSurface = eglCreatePbufferSurface(m_pkDisplay, config, size);
    m_pkContext = eglCreateContext(m_pkDisplay, config, EGL_NO_CONTEXT, nullptr);
    return m_pkSurface && m_pkContext && eglMakeCurrent(m_pkDisplay, m_pkSurface, m_pkSurface, m_pkContext);
}

COffscreenContext::~COffscreenContext()
{
    if (!m_pkDisplay)
        return;
    eglMakeCurrent(m_pkDisplay, EGL_NO_SURFACE, EGL_NO_SURFACE, EGL_NO_CONTEXT);
    if (m_pkContext)
        eglDestroyContext(m_pkDisplay, m_pkContext);
    if (m_pkSurface)
        eglDestroySurface(m_pkDisplay, m_pkSurface);
}

RgbPicture COffscreenContext::ReadPixels(int width, int height) const
{
    RgbPicture picture(width, height);
    glPixelStorei(GL_PACK_ALIGNMENT, 1);
    glReadPixels(0, 0, width, height, GL_RGB, GL_UNSIGNED_BYTE, picture.rgb.data());
    // GL's first row is the bottom one.
    for (int top = 0, bottom = height - 1; top < bottom; ++top, --bottom)
        std::swap_ranges(picture.Pixel(0, top), picture.Pixel(0, top + 1), picture.Pixel(0, bottom));
    return picture;
}

} // namespace gw
