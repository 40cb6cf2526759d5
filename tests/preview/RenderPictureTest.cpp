// Whole pictures: what each of their parts shows.

#include "RenderPicture.h"
#include "PreviewScene.h"

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

} // namespace
} // namespace gw
