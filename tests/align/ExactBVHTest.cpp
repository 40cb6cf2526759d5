// A motion that is written exactly reads back unchanged.

#include "BoneMeshQueries.h"
#include "CBoneMesh.h"
#include "CMadeBody.h"
#include "Directions.h"
#include "Rotations.h"
#include "Skeleton.h"
#include "TKBVHStream.h"
#include "TempFolder.h"

#include <gtest/gtest.h>

namespace gw {
namespace {

// Writes a body's motion, reads it again, and returns the text in between.
std::string ExpectReadsAgain(const CMadeBody& body)
{
    CNode* const root = body.Motion().root;
    const float frequency = body.Motion().frequency;
    const int frameCount = body.Motion().frameCount;
    const CTempFolder folder;
    TKBVHStream stream;
    stream.motionRoot = root;
    EXPECT_TRUE(stream.WriteExact(folder.Path("a.bvh")));
    CMotionFile again;
    EXPECT_TRUE(again.Load(folder.Path("a.bvh")));
    EXPECT_EQ(again.GetKeyCount(), frameCount);
    EXPECT_EQ(again.GetFrequency(), frequency);
    const std::vector<CNode*> nodes = NodesOf(*root);
    const std::vector<CNode*> nodesAgain = NodesOf(*again.motionRoot);
    EXPECT_EQ(nodes.size(), nodesAgain.size());
    for (int frame = 0; frame < frameCount; ++frame)
    {
        const std::vector<Mat4> before = WorldsAt(*root, frequency, frame);
        const std::vector<Mat4> after = WorldsAt(*again.motionRoot, frequency, frame);
        for (size_t i = 0; i < before.size(); ++i)
        {
            EXPECT_LT(Vec3Length(before[i].Translation() - after[i].Translation()), 0.001) << frame;
            EXPECT_LT(DegreesBetween(NormalizedRows(before[i]), NormalizedRows(after[i])), 0.001) << frame;
        }
    }
    for (size_t i = 0; i < nodes.size(); ++i)
    {
        const bool ends = nodes[i]->HasNoNodeChild();
        EXPECT_LT(ends ? Vec3Length(NodeBoneEnd(*nodes[i]) - NodeBoneEnd(*nodesAgain[i])) : 0.0, 1e-5);
    }
    return ReadBytes(folder.Path("a.bvh"));
}

TEST(WriteExact, KeepsFramesPlacesAndEnds)
{
    const std::string text = ExpectReadsAgain(CMadeBody{{}});
    EXPECT_EQ(text.find("CHANNELS 6", text.find("JOINT")), std::string::npos)
        << "positions at the root alone";
}

TEST(WriteExact, KeepsRotationsWhereTwoAxesMeet)
{
    const CMadeBody body{{}};
    CKeyframeControl& track = body.Track("UpperTorso");
    for (size_t frame = 0; frame < track.m_kRotationKeys.size(); ++frame)
    {
        const auto number = static_cast<double>(frame);
        const Mat3 y = TurnAbout(kVec3UnitY, frame % 2 ? 90.0 : -90.0 + 1e-4 * number);
        track.m_kRotationKeys[frame] =
            QuatFromMat3(TurnAbout(kVec3UnitX, 9.0 * number) * y * TurnAbout(kVec3UnitZ, 33.0));
    }
    ExpectReadsAgain(body);
}

TEST(WriteExact, GivesPositionsToJointsThatMove)
{
    const CMadeBody body{{}};
    body.Track("LHand").m_kPositionKeys.Expand()[17].y += 2.5f;
    const std::string text = ExpectReadsAgain(body);
    const size_t hand = text.find("JOINT LHand");
    EXPECT_LT(text.find("CHANNELS 6", hand), text.find("JOINT", hand + 1));
}

TEST(WriteExact, NeedsAMotion)
{
    TKBVHStream stream;
    EXPECT_FALSE(stream.WriteExact(CTempFolder().Path("a.bvh")));
    EXPECT_EQ(stream.Record().Failure().reason, EFailure::NoRoot);
}

} // namespace
} // namespace gw
