// Marks are measured in the background, and each step cancels those of the step before.

#include "ContentFixture.h"

#include <chrono>
#include <thread>

namespace gw {
namespace {

class Marks : public ContentTest
{
protected:
    void WaitForMarks()
    {
        while (m_kContent.UpdateMarks())
            std::this_thread::sleep_for(std::chrono::milliseconds(1));
    }
};

TEST_F(Marks, BelongToTheOpenResult)
{
    Open(Write("walk.bvh", BvhText(kPoserBones, 40)));
    Do("click convert");
    EXPECT_EQ(m_kContent.Marks().frameCount, 0) << "not in the way of the conversion";
    WaitForMarks();
    ASSERT_EQ(m_kContent.Marks().frameCount, 40);
    ASSERT_EQ(m_kContent.Marks().worst.size(), 3u);
    std::set<float> visited;
    for (int step = 0; step < 4; ++step)
    {
        m_kContent.GoToNextWorst();
        visited.insert(m_kWindow.m_pkSource->GetTime());
        EXPECT_EQ(m_kWindow.m_pkSource->GetTime(), m_kWindow.m_pkResult->GetTime());
    }
    EXPECT_EQ(visited.size(), 3u) << "the first one follows the last one";

    m_kWindow.m_kAnswers[139] = EAnswer::No; // the result need not be saved
    // Steps that follow faster than a measurement ends.
    for (const int frames : {2000, 3000, 50})
    {
        Open(Write("walk.bvh", BvhText(kPoserBones, frames)));
        EXPECT_EQ(m_kContent.Marks().frameCount, 0);
        Do("click convert, click play, click convert");
    }
    WaitForMarks();
    EXPECT_EQ(m_kContent.Marks().frameCount, 50);
    Open(Write("other.bvh", BvhText(kMaxBones)));
    Do("click convert");
    m_kWindow.folderAnswer = FolderChoice{m_kFolder.Path()};
    m_kContent.RunBatch();
    WaitForMarks();
    EXPECT_EQ(m_kContent.Marks().frameCount, 0) << "a batch run leaves no result to look at";
}

} // namespace
} // namespace gw
