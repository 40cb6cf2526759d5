#include "GLPainter.h"

#include "GLScene.h"

#include <GL/gl.h>
#include <GL/glu.h>

namespace gw {

namespace {

constexpr double kNearPlane = 1.0;
constexpr double kFarPlane = 10'000.0;

void LookThrough(const GLScene& scene)
{
    const Vec3& eye = scene.eye;
    const Vec3& at = scene.lookAt;
    const Vec3& up = scene.up;
    gluLookAt(eye.x, eye.y, eye.z, at.x, at.y, at.z, up.x, up.y, up.z);
}

// Draws the whole list with one call. One call per triangle draws the same pixels but takes a third longer.
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

void PaintGL(const GLScene& scene)
{
    glClear(GL_COLOR_BUFFER_BIT);
    glLoadIdentity();
    glTranslatef(scene.pan.x, scene.pan.y, scene.pan.z);
    glPushMatrix();
    LookThrough(scene);
    DrawLines(scene.ends);
    glPopMatrix();
    glFinish();
}

} // namespace gw
