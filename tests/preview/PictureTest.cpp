// Pixels drawn without a display. If the machine's GL cannot create such a context, the tests are skipped.

#include "COffscreenContext.h"
#include "GLPainter.h"
#include "GLScene.h"
#include "PreviewScene.h"

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
    void SetUp() override
    {
        if (!m_kContext.Create(kSide, kSide))
            GTEST_SKIP() << "no picture can be drawn here";
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
};

// A scene of triangles on top of each other, with names.
Ref<CNode> Triangles(std::initializer_list<const char*> names)
{
    Ref<CNode> scene = MakeScene(kBound);
    for (const char* name : names)
        AttachBone(*scene, name, 1);
    scene->UpdateScene(0.0f, true);
    scene->m_kBound = kBound;
    return scene;
}

TEST_F(PictureTest, NothingIsTheClearColour)
{
    EXPECT_EQ(CountColor(Draw(nullptr), kClearColor), kSide * kSide);
    EXPECT_EQ(CountColor(Draw(MakeScene(kBound).Get()), kClearColor), kSide * kSide);
}

TEST_F(PictureTest, LaterMeshesCoverEarlierOnes)
{
    const Ref<CNode> scene = Triangles({"first", "second"});
    EXPECT_EQ(CountColor(Draw(scene.Get(), "first"), kHighlightColor), 0);
    const RgbPicture picture = Draw(scene.Get(), "second");
    EXPECT_GT(CountColor(picture, kHighlightColor), 50);
    EXPECT_EQ(CountColor(picture, kBoneColor), 0);
}

TEST_F(PictureTest, SceneFollowsTheMouse)
{
    const Ref<CNode> scene = Triangles({"bone"});
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
    const Ref<CNode> scene = Triangles({"bone"});
    const RgbPicture before = Draw(scene.Get());
    ResizeGL(0, 50);
    ResizeGL(50, 0);
    EXPECT_EQ(Draw(scene.Get()).rgb, before.rgb);
}

} // namespace
} // namespace gw
