// What a BVH file becomes and what is written of it.

#include "Angles.h"
#include "BoneMeshQueries.h"
#include "CBoneMesh.h"
#include "MotionTexts.h"
#include "Rotations.h"
#include "Skeleton.h"
#include "TKBVHStream.h"

#include <gtest/gtest.h>
#include <tuple>

namespace gw {
namespace {

constexpr double kTolerance = 1e-3; // degrees

Mat3 About(const Vec3& axis, float degrees)
{
    return Mat3FromAxisAngle(axis, degrees * kDegreesToRadians);
}

// A root of one frame.
std::string OneJoint(const std::string& channels, const std::string& row)
{
    return "HIERARCHY\nROOT R\n{\nOFFSET 1 2 3\nCHANNELS " + channels +
           "\n}\nMOTION\nFrames: 1\nFrame Time: 1\n" + row;
}

TEST(TKBVHStream, MultipliesChannelsInFromTheLeft)
{
    const Mat3 x = About(kVec3UnitX, 20);
    const Mat3 y = About(kVec3UnitY, 50);
    const Mat3 z = About(kVec3UnitZ, -70);
    const std::tuple<const char*, std::string, std::string, Mat3, Vec3> rows[] = {
        {"ZXY", "3 Zrotation Xrotation Yrotation", "-70 20 50", y * x * z, {1, 2, 3}},
        {"YZX", "3 Yrotation Zrotation Xrotation", "50 -70 20", x * z * y, {1, 2, 3}},
        {"one axis twice", "2 Xrotation Xrotation", "15 5", x, {1, 2, 3}},
        {"beyond a turn", "1 Zrotation", "650", z, {1, 2, 3}},
        {"positions alone", "2 Zposition Xposition", "5 6", kMat3Identity, {7, 2, 8}},
        {"rotation first", "3 Zrotation Yposition Xrotation", "-70 4 20", x * z, {1, 6, 3}},
        {"scales between", "3 Zrotation Yscale Xrotation", "-70 4 20", x * z, {1, 2, 3}},
    };
    for (const auto& [what, channels, row, rotation, position] : rows)
    {
        SCOPED_TRACE(what);
        CLoadedMotion file(OneJoint(channels, row), "a.bvh");
        ASSERT_TRUE(file.loaded);
        const Mat4& local = file.motion.motionRoot->m_kMatrix;
        EXPECT_LT(DegreesBetween(NormalizedRows(local), rotation), kTolerance);
        EXPECT_EQ(local.Translation(), position);
        EXPECT_NEAR(Vec3Length(RowLengths(local) - kVec3One), 0.0, 1e-6);
    }
}

TEST(TKBVHStream, GivesEveryNodeATrackAndFrames)
{
    CLoadedMotion file(kSmallBVH, "a.bvh");
    ASSERT_TRUE(file.loaded);
    EXPECT_EQ(file.motion.GetFrequency(), 0.04f);
    EXPECT_EQ(file.motion.GetLastFrame(), 2.0f);
    EXPECT_EQ(file.motion.motionRoot->m_kMatrix.Translation(), (Vec3{11, 22, 33})) << "stands at frame 0";

    const Mat3 hips = About(kVec3UnitX, 45) * About(kVec3UnitZ, -90);
    const Mat3 chest = About(kVec3UnitZ, 90);
    const CNode& node = PosedNode(file.motion, "Chest", 2);
    EXPECT_LT(DegreesBetween(NormalizedRows(node.m_kMatrix), chest), kTolerance);
    EXPECT_LT(DegreesBetween(NormalizedRows(node.m_kWorldMatrix), chest * hips), kTolerance);
    // The offset (0, 10, 0), tilted about X and then turned to +X about Z.
    ExpectNear(node.m_kWorldMatrix.Translation(), {13 + 7.0710678f, 24, 35 + 7.0710678f}, 1e-4);

    SwitchControls(*file.motion.motionRoot, false);
    EXPECT_EQ(PosedNode(file.motion, "Chest", 1).m_kWorldMatrix.Translation(), (Vec3{1, 12, 3}))
        << "rest pose";
}

TEST(TKBVHStream, PointsBoneMeshesAtTheChild)
{
    const std::tuple<const char*, std::string, float, Vec3> rows[] = {
        {"up", "0 3 0", 3, {0, 1, 0}},
        {"down", "0 -3 0", 3, {0, -1, 0}},
        {"along X", "3 0 0", 3, {1, 0, 0}},
        {"along Z", "0 0 3", 3, {0, 0, 1}},
        {"in the XY plane", "3 -3 0", 4.2426407f, {0.7071068f, -0.7071068f, 0}},
        // The two angles are taken from projections, so that a slanted bone is only nearly met.
        {"slanted", "3 3 3", 5.1961524f, {0.5f, 0.7071068f, 0.5f}},
        {"nowhere", "0 0 0", 0, {1, 0, 0}},
    };
    for (const auto& [what, offset, length, direction] : rows)
    {
        SCOPED_TRACE(what);
        const CLoadedMotion file("HIERARCHY\nROOT R\n{\nEnd Site\n{\nOFFSET " + offset +
                                     "\n}\n}\nMOTION\nFrames: 0\nFrame Time: 1\n",
                                 "a.bvh");
        ASSERT_TRUE(file.loaded);
        const CBoneMesh* mesh = FindBoneMesh(*file.motion.motionRoot);
        ASSERT_TRUE(dynamic_cast<const CBoneShapeMesh*>(mesh));
        EXPECT_STREQ(mesh->GetName(), "R");
        EXPECT_FLOAT_EQ(mesh->m_fLength, length);
        ExpectNear(TransformCoord(kVec3UnitY, mesh->m_kMatrix), direction, 1e-6);
    }
}

TEST(TKBVHStream, GivesBranchesABallAndLeavesNothing)
{
    const CLoadedMotion file(
        "HIERARCHY\nROOT R\n{\nJOINT A\n{\nOFFSET 0 0 -7\n}\nJOINT B\n{\nOFFSET 2 3 6\n}\n"
        "End Site\n{\nOFFSET 1 1 1\n}\n}\nMOTION\nFrames: 0\nFrame Time: 1\n",
        "a.bvh");
    ASSERT_TRUE(file.loaded);
    CNode& root = *file.motion.motionRoot;
    ASSERT_TRUE(dynamic_cast<CBoneNodeMesh*>(FindBoneMesh(root)));
    EXPECT_EQ(NodeBoneLength(root), 7.0f);
    EXPECT_EQ(FindBoneMesh(root)->m_kMatrix, kMat4Identity);
    EXPECT_FALSE(FindBoneMesh(*FindNode(&root, "A"))) << "a joint without an end site has no length";
}

// The last frame of a motion is not written. The angles of the one before were worked out apart from the
// program and differ from these by a few units in the last place.
TEST(TKBVHStream, WritesTheseBytes)
{
    CLoadedMotion file(Changed(kSmallBVH, {"", "OFFSET 0 0 5", "OFFSET 0 5 0"}), "a.bvh");
    TKBVHStream writer(file.motion);
    ASSERT_TRUE(writer.WriteFile(file.folder.Path("b.bvh")));
    EXPECT_EQ(
        ReadText(file.folder.Path("b.bvh")),
        R"(HIERARCHY
ROOT Hips
{
    OFFSET 1.000000 2.000000 3.000000
    CHANNELS 6 Xposition Yposition Zposition Zrotation Yrotation Xrotation
    JOINT Chest
    {
        OFFSET 0.000000 10.000000 0.000000
        CHANNELS 3 Zrotation Yrotation Xrotation
        End Site
        {
            OFFSET 1.000000 0.000000 0.000000
        }
    }
}
MOTION
Frames: 2
Frame Time: 0.040000
)"
        "10.000000 20.000000 30.000000 0.000000 -0.000000 0.000000 0.000000 -0.000000 0.000000 \n"
        "11.000000 21.000000 31.000000 21.170229 28.024323 22.795876 70.540199 -15.263489 59.308964 \n");
    EXPECT_FALSE(TKBVHStream().WriteFile(file.folder.Path("c.bvh"))) << "no motion";
    EXPECT_FALSE(writer.WriteFile(file.folder.Path("none/d.bvh")));
    EXPECT_EQ(RecordText(writer.Record()), "failed WriteError 0 \n");
}

} // namespace
} // namespace gw
