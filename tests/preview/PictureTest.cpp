// Pixels drawn without a display. If the machine's GL cannot create such a context, the tests return.

#include "COffscreenContext.h"
#include "GLPainter.h"
#include "GLScene.h"
#include "Pixels.h"
#include "PreviewScene.h"

#include <GL/gl.h>
#include <gtest/gtest.h>
#include <tuple>

namespace gw {
namespace {

constexpr int kSide = 200;
constexpr LineColor kClearColor{51, 51, 51};
constexpr BoundSphere kBound{kVec3Zero, 40}; // the eye is 100 away: about 2.4 pixels per unit

class PictureTest : public testing::Test
{
protected:
    PictureTest() : m_bCanDraw(m_kContext.Create(kSide, kSide))
    {
        if (!m_bCanDraw)
            return;
        InitGL();
        ResizeGL(kSide, kSide);
    }

    RgbPicture Draw(CGLView& view)
    {
        PaintGL(SceneOf(view));
        return m_kContext.ReadPixels(kSide, kSide);
    }
    RgbPicture Draw(CNode* scene, const char* highlight = "")
    {
        CGLView view;
        view.SetScene(scene, 1.0f, 1.0f);
        view.SetHighlight(highlight);
        return Draw(view);
    }

    COffscreenContext m_kContext;
    bool m_bCanDraw;
};

TEST_F(PictureTest, NothingIsTheClearColour)
{
    if (!m_bCanDraw)
        return;
    EXPECT_EQ(CountColor(Draw(nullptr), kClearColor), kSide * kSide);
    EXPECT_EQ(CountColor(Draw(MakeScene(kBound).Get()), kClearColor), kSide * kSide);
}

// The world is rotated so that each axis in turn points up: 4 units, which are 9 to 10 pixels.
TEST_F(PictureTest, AxesAreRedGreenAndBlue)
{
    if (!m_bCanDraw)
        return;
    const Mat4 upward[] = {
        {{0, 1, 0, 0, 0, 0, 1, 0, 1, 0, 0, 0, 0, 0, 0, 1}},
        {{1, 0, 0, 0, 0, 1, 0, 0, 0, 0, 1, 0, 0, 0, 0, 1}},
        {{0, 0, 1, 0, 1, 0, 0, 0, 0, 1, 0, 0, 0, 0, 0, 1}},
    };
    for (size_t axis = 0; axis < 3; ++axis)
    {
        SCOPED_TRACE(axis);
        const Ref<CNode> scene = MakeScene(kBound);
        AttachBone(*scene, "bone", 0).m_kWorldMatrix = upward[axis];
        const RgbPicture picture = Draw(scene.Get());
        const int above = CountColor(picture, kAxisColors[axis], {99, 80, 101, 100});
        EXPECT_GE(above, 8);
        EXPECT_LE(above, 10);
        EXPECT_EQ(CountColor(picture, kAxisColors[axis], {0, 102, kSide, kSide}), 0)
            << "nothing below the origin";
    }
}

TEST_F(PictureTest, LaterMeshesCoverEarlierOnes)
{
    if (!m_bCanDraw)
        return;
    const Ref<CNode> scene = MakeScene(kBound);
    AttachBone(*scene, "first", 1);
    AttachBone(*scene, "second", 1);
    scene->UpdateScene(0.0f, true);
    scene->m_kBound = {kVec3Zero, 40};
    EXPECT_EQ(CountColor(Draw(scene.Get(), "first"), kHighlightColor), 0);
    const RgbPicture picture = Draw(scene.Get(), "second");
    EXPECT_GT(CountColor(picture, kHighlightColor), 50);
    EXPECT_EQ(CountColor(picture, kBoneColor), 0);
}

TEST_F(PictureTest, SceneFollowsTheMouse)
{
    if (!m_bCanDraw)
        return;
    const Ref<CNode> scene = MakeScene(kBound);
    AttachBone(*scene, "bone", 1);
    scene->UpdateScene(0.0f, true);
    scene->m_kBound = kBound;
    CGLView view;
    view.SetScene(scene.Get(), 1.0f, 1.0f);
    const int before = CountColor(Draw(view), kBoneColor);
    view.MouseDown(0, 0);
    view.MouseMove(150, -150, {}); // 30 units of 41 to the right and upper sides
    RgbPicture picture = Draw(view);
    const int moved = CountColor(picture, kBoneColor, {100, 0, kSide, 100});
    EXPECT_GT(moved, before / 2);
    EXPECT_EQ(CountColor(picture, kBoneColor), moved);
    view.FrameAll();
    view.MouseMove(150, -650, {.leftCtrl = true});
    picture = Draw(view);
    EXPECT_LT(CountColor(picture, kBoneColor), before) << "further away";
    EXPECT_GT(CountColor(picture, kBoneColor), 0);
}

// A triangle that fills the same part of the view at any distance.
TEST_F(PictureTest, ShowsWhatIsBetweenOneAndTenThousandAway)
{
    if (!m_bCanDraw)
        return;
    const std::tuple<float, bool> rows[] = {
        {0.98f, false},
        {1.02f, true},
        {9'800.0f, true},
        {10'200.0f, false},
    };
    for (const auto& [distance, shown] : rows)
    {
        SCOPED_TRACE(distance);
        const Ref<CNode> scene = MakeScene({});
        CTriMesh& mesh = AttachBone(*scene, "bone", 1);
        for (size_t i = 0; i < 3; ++i)
            mesh.WorldXYZBuffer()[i] = (mesh.XYZBuffer()[i] * 0.02f - kVec3UnitZ) * distance;
        CGLView view;
        view.SetScene(scene.Get(), 1.0f, 1.0f);
        view.m_kCamera.m_kLookAt = -kVec3UnitZ;
        EXPECT_EQ(CountColor(Draw(view), kBoneColor) > 50, shown);
    }
}

TEST_F(PictureTest, NoSizeKeepsTheOldProjection)
{
    if (!m_bCanDraw)
        return;
    const Ref<CNode> scene = MakeScene(kBound);
    AttachBone(*scene, "bone", 1);
    scene->UpdateScene(0.0f, true);
    const RgbPicture before = Draw(scene.Get());
    ResizeGL(0, 50);
    ResizeGL(50, 0);
    EXPECT_EQ(Draw(scene.Get()).rgb, before.rgb);
}

// Draws a separate loop for each triangle, which a single call for all lines must match.
void DrawByLoops(std::span<const LineEnd> ends)
{
    for (size_t i = 0; i < ends.size();)
    {
        const bool loop = ends[i].color == kBoneColor;
        glColor4ubv(&ends[i].color.red);
        glBegin(loop ? GL_LINE_LOOP : GL_LINES);
        for (const size_t end = i + (loop ? 6 : 2); i < end; i += loop ? 2 : 1)
            glVertex3fv(&ends[i].point.x);
        glEnd();
    }
}

TEST_F(PictureTest, LinesGiveThePixelsOfLoops)
{
    if (!m_bCanDraw)
        return;
    const Ref<CNode> scene = MakeScene(kBound);
    for (int bone = 0; bone < 20; ++bone)
    {
        const float turn = static_cast<float>(bone) * 0.37f;
        CTriMesh& mesh = AttachBone(*scene, "bone", 12, {turn, -turn, 0.0f});
        mesh.m_kMatrix = Mat4Compose(Mat3FromAxisAngle({0.6f, 0.0f, 0.8f}, turn), {turn, 1.3f, 0.7f});
    }
    scene->UpdateScene(0.0f, true);
    CGLView view;
    view.SetScene(scene.Get(), 1.0f, 1.0f);
    const RgbPicture byLines = Draw(view);
    glClear(GL_COLOR_BUFFER_BIT);
    glPushMatrix();
    const Vec3& eye = view.m_kCamera.m_kEye;
    glTranslatef(-eye.x, -eye.y, -eye.z); // the view looks along -Z
    DrawByLoops(view.DrawScene().Ends());
    glPopMatrix();
    EXPECT_GT(CountColor(byLines, kBoneColor), 1000);
    EXPECT_EQ(m_kContext.ReadPixels(kSide, kSide).rgb, byLines.rgb);
}

} // namespace
} // namespace gw
