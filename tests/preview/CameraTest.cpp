// The camera's position for a scene, and the effect of dragging.

#include "PreviewScene.h"

#include <gtest/gtest.h>
#include <tuple>

namespace gw {
namespace {

constexpr DragKeys kCtrl{.leftCtrl = true};
constexpr DragKeys kShift{.leftShift = true};
constexpr DragKeys kBoth{.leftCtrl = true, .leftShift = true};

TEST(Camera, LooksAtTheMiddleOfAScene)
{
    CGLView view;
    view.SetScene(MakeScene({{1, 2, 3}, 2}).Get(), 1.0f, 1.0f);
    view.m_kPan = kVec3One;
    view.m_kCamera.m_kUp = kVec3UnitX;
    const Ref<CNode> scene = MakeScene({{10, 20, 30}, 4});
    view.SetScene(scene.Get(), 1.0f, 1.0f);
    const auto standsAt = [&](const Vec3& lookAt, const Vec3& eye) {
        EXPECT_EQ(view.m_kCamera.m_kLookAt, lookAt);
        EXPECT_EQ(view.m_kCamera.m_kEye, eye);
        EXPECT_EQ(view.m_kCamera.m_kUp, kVec3UnitY);
        EXPECT_EQ(view.m_kPan, kVec3Zero);
    };
    standsAt({10, 20, 30}, {10, 20, 40});

    scene->m_kBound.m_kCentre = {5, 6, 7};
    scene->m_kBound.m_fRadius = 2;
    view.m_kPan = kVec3One;
    view.FrameAll();
    standsAt({5, 6, 7}, {5, 6, 12});

    view.SetScene(nullptr, 1.0f, 1.0f);
    standsAt({5, 6, 7}, {5, 6, 12});
}

// The scene's size makes one pixel of the mouse one unit. Drags begin at (100, 100).
TEST(Mouse, DraggingMovesTheCamera)
{
    struct Move
    {
        int x;
        int y;
        DragKeys keys;
    };
    const std::tuple<const char*, std::vector<Move>, Vec3, float> rows[] = {
        {"right and up pans", {{110, 95, {}}}, {10, 5, 0}, 500},
        {"moves count from the last one", {{110, 95, {}}, {109, 96, {}}}, {9, 4, 0}, 500},
        {"Ctrl and up moves away", {{110, 95, kCtrl}}, kVec3Zero, 505},
        {"the eye stops at 0", {{100, 601, kCtrl}}, kVec3Zero, 0},
        {"and comes back from there", {{100, 900, kCtrl}, {100, 890, kCtrl}}, kVec3Zero, 10},
        {"Shift holds all", {{110, 95, kShift}}, kVec3Zero, 500},
        {"also with Ctrl", {{110, 95, kBoth}}, kVec3Zero, 500},
        {"held moves are passed over", {{150, 150, kShift}, {151, 150, {}}}, {1, 0, 0}, 500},
    };
    for (const auto& [what, moves, pan, eyeZ] : rows)
    {
        SCOPED_TRACE(what);
        CCountedView view;
        view.SetScene(MakeScene({kVec3Zero, 200}).Get(), 1.0f, 1.0f);
        view.MouseDown(100, 100);
        for (const Move& move : moves)
            view.MouseMove(move.x, move.y, move.keys);
        EXPECT_EQ(view.m_kPan, pan);
        EXPECT_EQ(view.m_kCamera.m_kEye, (Vec3{0, 0, eyeZ}));
        EXPECT_EQ(view.m_iRepaints, 1 + static_cast<int>(moves.size())) << "each is drawn, held ones too";
    }
}

TEST(Mouse, MovesNothingWithoutButtonOrScene)
{
    CCountedView view;
    view.SetScene(MakeScene({kVec3Zero, 200}).Get(), 1.0f, 1.0f);
    view.MouseMove(110, 95, {});
    view.MouseDown(100, 100);
    EXPECT_TRUE(view.IsDragging());
    view.MouseUp();
    view.MouseMove(110, 95, kCtrl);
    view.SetScene(nullptr, 0.0f, 0.0f);
    view.MouseDown(100, 100);
    view.MouseMove(110, 95, {});
    EXPECT_EQ(view.m_kPan, kVec3Zero);
    EXPECT_EQ(view.m_kCamera.m_kEye, (Vec3{0, 0, 500}));
    EXPECT_EQ(view.m_iRepaints, 2) << "for the scenes alone";
}

} // namespace
} // namespace gw
