// Whole pictures: their layout, their contents and their files.

#include "RenderPicture.h"
#include "Pixels.h"
#include "PreviewScene.h"

#include <gtest/gtest.h>
#include <tuple>

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
    const struct
    {
        const char* what;
        int frame;
        int poses;
        Times source;
        Times result;
    } rows[] = {
        {"one frame", 2, 1, {1}, {3}},
        {"a frame before the first one", -5, 1, {0}, {0}},
        {"a frame after the last one", 9, 1, {2}, {6}},
        {"a strip of the motion", 0, 3, {0, 1, 2}, {0, 3, 6}},
        {"a strip from a frame on", 2, 2, {1, 2}, {3, 6}},
        {"a strip longer than the motion", 3, 3, {1.5f, 1.5f, 2}, {4.5f, 4.5f, 6}},
    };
    for (const auto& row : rows)
    {
        SCOPED_TRACE(row.what);
        const Ref<CNode> source = MakeScene({});
        const Ref<CNode> result = MakeScene({});
        const CTimeKeeper& sourceTimes = AttachKeeper(*source);
        const CTimeKeeper& resultTimes = AttachKeeper(*result);
        PictureOptions options;
        options.motions.push_back({source, 0.5f, 4.0f});
        options.motions.push_back({result, 1.0f, 6.0f});
        options.frame = row.frame;
        options.poseCount = row.poses;
        RgbPicture picture;
        if (RenderPicture(options, picture) == EPictureAnswer::NoContext)
            return;
        EXPECT_EQ(DrawnTimes(sourceTimes, row.poses), row.source);
        EXPECT_EQ(DrawnTimes(resultTimes, row.poses), row.result);
    }
}

// Returns a motion that shows one triangle.
PictureMotion TriangleMotion(const char* boneName, const Vec3& place)
{
    const Ref<CNode> scene = MakeScene({});
    AttachBone(*scene, boneName, 1, place);
    return {scene, 1.0f, 4.0f};
}

// Draws source and result in different colors; empty if no picture can be drawn.
RgbPicture TwoMotions(int poseCount)
{
    PictureOptions options;
    options.motions = {TriangleMotion("source", {5000, 0, 0}), TriangleMotion("result", {0, -70, 0})};
    options.highlight = "result";
    options.width = 101;
    options.height = 73;
    options.poseCount = poseCount;
    RgbPicture picture;
    RenderPicture(options, picture);
    return picture;
}

TEST(RenderPicture, GivesEachPoseItsPart)
{
    const RgbPicture pair = TwoMotions(1);
    const RgbPicture strip = TwoMotions(3);
    if (pair.rgb.empty())
        return;
    const std::tuple<const char*, const RgbPicture&, PixelArea, LineColor, LineColor> rows[] = {
        {"left side", pair, {0, 0, 50, 73}, kBoneColor, kHighlightColor},
        {"right side", pair, {50, 0, 101, 73}, kHighlightColor, kBoneColor},
        {"first pose", strip, {0, 0, 33, 36}, kBoneColor, kHighlightColor},
        {"second pose", strip, {33, 0, 67, 36}, kBoneColor, kHighlightColor},
        {"third pose", strip, {67, 0, 101, 36}, kBoneColor, kHighlightColor},
        {"first pose of the result", strip, {0, 36, 33, 73}, kHighlightColor, kBoneColor},
        {"second pose of the result", strip, {33, 36, 67, 73}, kHighlightColor, kBoneColor},
        {"third pose of the result", strip, {67, 36, 101, 73}, kHighlightColor, kBoneColor},
    };
    for (const auto& [what, picture, area, shown, missing] : rows)
    {
        SCOPED_TRACE(what);
        EXPECT_GT(CountColor(picture, shown, area), 20);
        EXPECT_EQ(CountColor(picture, missing, area), 0);
        EXPECT_EQ(CountColor(picture, {0, 0, 0}, area), 0) << "a part that was not drawn";
    }
}

} // namespace
} // namespace gw
