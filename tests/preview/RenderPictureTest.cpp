// Whole pictures: what each of their parts shows.

#include "RenderPicture.h"
#include "PreviewScene.h"
#include "UprightPoint.h"

#include <gtest/gtest.h>

namespace gw {
namespace {

using Times = std::vector<float>;

// Returns the times of the drawn poses, which are the last updates.
Times DrawnTimes(const CTimeKeeper& keeper, int poses)
{
    const Times& all = keeper.m_kTimes;
    return {all.end() - poses, all.end()};
}

TEST(RenderPicture, ShowsAllMotionsAtTheSameShare)
{
    const std::tuple<const char*, int, int, Times, Times> rows[] = {
        {"one frame", 2, 1, {1}, {3}},
        {"a frame before the first one", -5, 1, {0}, {0}},
        {"a frame after the last one", 9, 1, {2}, {6}},
        {"a strip of the motion", 0, 3, {0, 1, 2}, {0, 3, 6}},
        {"a strip from a frame on", 2, 2, {1, 2}, {3, 6}},
        {"a strip longer than the motion", 3, 3, {1.5f, 1.5f, 2}, {4.5f, 4.5f, 6}},
    };
    for (const auto& [what, frame, poses, sourceTimes, resultTimes] : rows)
    {
        SCOPED_TRACE(what);
        const Ref<CNode> source = MakeScene({});
        const Ref<CNode> result = MakeScene({});
        const CTimeKeeper& sourceKeeper = AttachKeeper(*source);
        const CTimeKeeper& resultKeeper = AttachKeeper(*result);
        PictureOptions options;
        options.motions.push_back({source, 0.5f, 4.0f});
        options.motions.push_back({result, 1.0f, 6.0f});
        options.frame = frame;
        options.poseCount = poses;
        options.width = 101;
        options.height = 73;
        RgbPicture picture;
        if (RenderPicture(options, picture) == EPictureAnswer::NoContext)
            GTEST_SKIP() << "no picture can be drawn here";
        EXPECT_EQ(DrawnTimes(sourceKeeper, poses), sourceTimes);
        EXPECT_EQ(DrawnTimes(resultKeeper, poses), resultTimes);
        EXPECT_EQ(CountColor(picture, {0, 0, 0}), 0) << "a part that was not drawn";
    }
}

TEST(RenderPicture, SeesAFigureFromFourSides)
{
    const Vec3 left{1, 0, 0}; // so the figure faces +z
    const struct
    {
        const char* what;
        EPictureView view;
        Vec3 forward; ///< where a point ahead of the figure is seen; the last number is nearness
        Vec3 upward;
    } rows[] = {
        {"front: ahead is near and slightly low", EPictureView::Front, {0, -0.14f, 0.99f}, {0, 0.99f, 0.14f}},
        {"side: ahead is to the right", EPictureView::Side, {1, 0, 0}, {0, 0.99f, 0.14f}},
        {"top: ahead is below, and up is near", EPictureView::Top, {0, -1, 0}, {0, 0, 1}},
    };
    for (const auto& row : rows)
    {
        SCOPED_TRACE(row.what);
        const CPictureCamera camera(row.view, left);
        EXPECT_LT(Vec3Length(camera.Project({5, 5, 6}, {5, 5, 5}) - row.forward), 0.01);
        EXPECT_LT(Vec3Length(camera.Project({5, 6, 5}, {5, 5, 5}) - row.upward), 0.01);
    }
}

TEST(RenderPicture, TurnsAnyAxisUprightWithoutMirroring)
{
    const Vec3 axes[] = {{0, 1, 0}, {0, -1, 0}, {0, 0, 1}, {0, 0, -1}, {1, 0, 0}, {-1, 0, 0}};
    for (const Vec3& up : axes)
    {
        EXPECT_EQ(UprightPoint(up, up), kVec3UnitY);
        const Vec3 x = UprightPoint(kVec3UnitX, up);
        EXPECT_EQ(Vec3Cross(x, UprightPoint(kVec3UnitY, up)), UprightPoint(kVec3UnitZ, up));
    }
}

} // namespace
} // namespace gw
