// The playback clock: its time after each operation, the updates it causes, and the scene it keeps.

#include "PreviewScene.h"

#include <gtest/gtest.h>
#include <tuple>

namespace gw {
namespace {

constexpr float kStep = 0.5f;
constexpr float kLastFrame = 4.0f; // so that the end is at 2

using View = CGLView;
using Operations = std::vector<void (View::*)()>;

void ExpectStand(int eighth, const Operations& operations, float time, bool plays)
{
    const Ref<CNode> scene = MakeScene({});
    const CTimeKeeper& keeper = AttachKeeper(*scene);
    CCountedView view;
    view.SetScene(scene.Get(), kStep, kLastFrame);
    EXPECT_TRUE(keeper.m_kTimes.empty()) << "a new scene is shown as it stands";
    view.Seek(eighth, 8);
    view.Seek(0, 0); // a scroll bar without a range is no place
    for (const auto operation : operations)
        (view.*operation)();
    EXPECT_EQ(view.GetTime(), time);
    EXPECT_EQ(view.IsPlaying(), plays);
    EXPECT_EQ(keeper.m_kTimes.back(), time) << "what is shown is where the clock stands";
    EXPECT_EQ(view.m_iRepaints, 1 + static_cast<int>(keeper.m_kTimes.size()));
}

// Starts at an eighth of the motion, which is half a frame.
TEST(Clock, StandsWhereEachOperationLeavesIt)
{
    const std::tuple<const char*, int, Operations, float, bool> rows[] = {
        {"a place on the scroll bar", 2, {}, 0.5f, false},
        {"a place past its end", 9, {}, 2.0f, false},
        {"a step on", 2, {&View::StepForward}, 1.0f, false},
        {"a step back", 4, {&View::StepBack}, 0.5f, false},
        {"from between two frames to the end", 7, {&View::StepForward}, 2.0f, false},
        {"from between two frames to the start", 1, {&View::StepBack}, 0.0f, false},
        {"no step past the end", 3, {&View::SeekEnd, &View::StepForward}, 2.0f, false},
        {"no step before the start", 3, {&View::SeekStart, &View::StepBack}, 0.0f, false},
        {"a tick while stopped", 2, {&View::Advance}, 0.5f, false},
        {"a tick while playing", 2, {&View::Play, &View::Advance}, 1.0f, true},
        {"a tick that reaches the end", 6, {&View::Play, &View::Advance}, 0.0f, false},
        {"a tick that passes the end", 7, {&View::Play, &View::Advance}, 0.0f, false},
        {"a tick at the end", 8, {&View::Play, &View::Advance}, 0.0f, false},
        {"a step while playing", 2, {&View::Play, &View::StepForward}, 1.0f, true},
        {"a tick after stopping", 2, {&View::Play, &View::Stop, &View::Advance}, 0.5f, false},
    };
    for (const auto& [what, eighth, operations, time, plays] : rows)
    {
        SCOPED_TRACE(what);
        ExpectStand(eighth, operations, time, plays);
    }
}

TEST(Clock, NothingMovesInOneFrameOrWithoutAScene)
{
    for (const Ref<CNode>& scene : {MakeScene({}), Ref<CNode>()})
    {
        CCountedView view;
        view.SetScene(scene.Get(), kStep, scene ? 0.0f : kLastFrame);
        view.Play();
        view.Advance();
        view.StepForward();
        view.Seek(1, 2);
        view.SeekEnd();
        view.StepBack();
        view.Stop();
        EXPECT_EQ(view.GetTime(), 0.0f);
        view.Play();
        EXPECT_EQ(view.IsPlaying(), scene != nullptr);
        view.Advance();
        EXPECT_EQ(view.GetTime(), 0.0f);
        EXPECT_FALSE(view.IsPlaying());
        EXPECT_TRUE(scene || view.m_iRepaints == 1) << "only the empty view is shown";
    }
}

TEST(Scene, LivesAsLongAsItIsShown)
{
    CGLView view;
    CNode* const scene = new CNode;
    Watch<CNode> watch;
    watch.Set(scene);
    Watch<CTriMesh> mesh;
    mesh.Set(&AttachBone(*scene, "bone", 1));
    view.SetScene(scene, kStep, kLastFrame);
    view.SetScene(scene, kStep, kLastFrame);
    ASSERT_TRUE(watch) << "the view alone keeps it, also when it is given again";
    EXPECT_FALSE(view.DrawScene().Ends().empty());
    view.SetScene(nullptr, 0.0f, 0.0f);
    EXPECT_FALSE(watch);
    EXPECT_FALSE(mesh) << "what was drawn is not kept either";
    EXPECT_TRUE(view.DrawScene().Ends().empty());
}

TEST(Scene, AnotherOneStopsTheClock)
{
    CGLView view;
    view.SetScene(MakeScene({}).Get(), kStep, kLastFrame);
    for (const Ref<CNode>& next : {MakeScene({}), Ref<CNode>()})
    {
        view.Play();
        view.Advance();
        view.SetScene(next.Get(), 0.25f, 7.0f);
        EXPECT_FALSE(view.IsPlaying());
        EXPECT_EQ(view.GetTime(), 0.0f);
        EXPECT_EQ(view.GetFrameStep(), 0.25f);
        EXPECT_EQ(view.GetLastFrame(), 7.0f);
    }
}

} // namespace
} // namespace gw
