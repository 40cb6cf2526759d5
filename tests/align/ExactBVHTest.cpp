// A motion that is written exactly reads back unchanged.

#include "BoneMeshQueries.h"
#include "CBoneMesh.h"
#include "CKeyframeControl.h"
#include "CMadeBody.h"
#include "Directions.h"
#include "Rotations.h"
#include "Skeleton.h"
#include "TKBVHStream.h"
#include "TempFolder.h"

#include <gtest/gtest.h>

namespace gw {
namespace {

// Writes the motion and reads it again.
void ExpectReadsAgain(CNode& root, float frequency, int frameCount, std::string& text)
{
    const CTempFolder folder;
    TKBVHStream stream;
    stream.motionRoot = &root;
    ASSERT_TRUE(stream.WriteExact(folder.Path("a.bvh")));
    text = ReadBytes(folder.Path("a.bvh"));
    CMotionFile again;
    ASSERT_TRUE(again.Load(folder.Path("a.bvh")));
    EXPECT_EQ(again.GetKeyCount(), frameCount);
    EXPECT_EQ(again.GetFrequency(), frequency);
    for (int frame = 0; frame < frameCount; ++frame)
    {
        const std::vector<Mat4> before = WorldsAt(root, frequency, frame);
        const std::vector<Mat4> after = WorldsAt(*again.motionRoot, frequency, frame);
        ASSERT_EQ(before.size(), after.size());
        for (size_t i = 0; i < before.size(); ++i)
        {
            EXPECT_LT(Vec3Length(before[i].Translation() - after[i].Translation()), 0.001) << frame;
            EXPECT_LT(DegreesBetween(NormalizedRows(before[i]), NormalizedRows(after[i])), 0.001) << frame;
        }
    }
    const std::vector<CNode*> nodes = NodesOf(root);
    const std::vector<CNode*> nodesAgain = NodesOf(*again.motionRoot);
    for (size_t i = 0; i < nodes.size(); ++i)
    {
        const bool ends = nodes[i]->HasNoNodeChild();
        EXPECT_LT(ends ? Vec3Length(NodeBoneEnd(*nodes[i]) - NodeBoneEnd(*nodesAgain[i])) : 0.0, 1e-5);
    }
}

TEST(WriteExact, KeepsFramesPlacesAndEnds)
{
    const CMadeBody body{{}};
    std::string text;
    ExpectReadsAgain(*body.Motion().root, body.Motion().frequency, 40, text);
    EXPECT_EQ(text.find("CHANNELS 6", text.find("JOINT")), std::string::npos)
        << "positions at the root alone";
}

TEST(WriteExact, KeepsRotationsWhereTwoAxesMeet)
{
    const CMadeBody body{{}};
    auto& track = static_cast<CKeyframeControl&>(*body.Joint("UpperTorso").GetControl());
    for (size_t frame = 0; frame < track.m_kRotationKeys.size(); ++frame)
    {
        const double y = frame % 2 ? 90.0 : -90.0 + 1e-4 * static_cast<double>(frame);
        track.m_kRotationKeys[frame] = QuatFromMat3(TurnAbout(kVec3UnitX, 9.0 * static_cast<double>(frame)) *
                                                    TurnAbout(kVec3UnitY, y) * TurnAbout(kVec3UnitZ, 33.0));
    }
    std::string text;
    ExpectReadsAgain(*body.Motion().root, body.Motion().frequency, 40, text);
}

TEST(WriteExact, GivesPositionsToJointsThatMove)
{
    const CMadeBody body{{}};
    auto& track = static_cast<CKeyframeControl&>(*body.Joint("LHand").GetControl());
    track.m_kPositionKeys.Expand()[17].y += 2.5f;
    std::string text;
    ExpectReadsAgain(*body.Motion().root, body.Motion().frequency, 40, text);
    const size_t hand = text.find("JOINT LHand");
    EXPECT_LT(text.find("CHANNELS 6", hand), text.find("JOINT", hand + 1));
}

TEST(WriteExact, NeedsAMotion)
{
    const CTempFolder folder;
    TKBVHStream stream;
    EXPECT_FALSE(stream.WriteExact(folder.Path("a.bvh")));
    EXPECT_EQ(stream.Record().Failure().reason, EFailure::NoRoot);
}

} // namespace
} // namespace gw
