#include "GLPainter.h"

#include "CGLView.h"

#include <GL/gl.h>
#include <GL/glu.h>

namespace gw {

namespace {

constexpr double kNearPlane = 1.0;
constexpr double kFarPlane = 10'000.0;

void LookThrough(const CCamera& camera)
{
    const Vec3& eye = camera.m_kEye;
    const Vec3& at = camera.m_kLookAt;
    const Vec3& up = camera.m_kUp;
    gluLookAt(eye.x, eye.y, eye.z, at.x, at.y, at.z, up.x, up.y, up.z);
}

// The whole list by one call. A call for each triangle gives the same pixels and takes a third longer.
void DrawLines(std::span<const LineEnd> ends)
{
    if (ends.empty())
        return;
    glEnableClientState(GL_VERTEX_ARRAY);
    glEnableClientState(GL_COLOR_ARRAY);
    glVertexPointer(3, GL_FLOAT, sizeof(LineEnd), &ends[0].point);
    glColorPointer(4, GL_UNSIGNED_BYTE, sizeof(LineEnd), &ends[0].color);
    glDrawArrays(GL_LINES, 0, static_cast<GLsizei>(ends.size()));
    glDisableClientState(GL_COLOR_ARRAY);
    glDisableClientState(GL_VERTEX_ARRAY);
}

} // namespace

void InitGL()
{
    glShadeModel(GL_FLAT);
    glClearColor(0.2f, 0.2f, 0.2f, 0.0f);
}

void ResizeGL(int width, int height)
{
    if (width < 1 || height < 1)
        return;
    glViewport(0, 0, width, height);
    glMatrixMode(GL_PROJECTION);
    glLoadIdentity();
    gluPerspective(kAngleOfView, static_cast<double>(width) / height, kNearPlane, kFarPlane);
    glMatrixMode(GL_MODELVIEW);
    glLoadIdentity();
}

void PaintGL(CGLView& view)
{
    glClear(GL_COLOR_BUFFER_BIT);
    glLoadIdentity();
    glTranslatef(view.m_kPan.x, view.m_kPan.y, view.m_kPan.z);
    glPushMatrix();
    LookThrough(view.m_kCamera);
    DrawLines(view.DrawScene().Ends());
    glPopMatrix();
    glFinish();
}

} // namespace gw
