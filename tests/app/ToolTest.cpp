// The map tool, from loading motions to saving a result.

#include "Rotations.h"
#include "ToolFixture.h"

#include <filesystem>
#include <tuple>

namespace gw {

TEST_F(ToolTest, ASourceBringsTheFixedSkeletonAlong)
{
    LoadSource();
    EXPECT_EQ(m_kToolWindow.m_kAsked.filter, "Anm Files (*.bvh;*.htr) |*.bvh;*.htr||");
    EXPECT_EQ(m_kToolWindow.m_kAsked.defaultExtension, "htr");
    EXPECT_EQ(m_kTool.SourceTree().Items().size(), 7u);
    EXPECT_EQ(m_kTool.TargetTree().Items().front().m_kText, "LowerTorso");
    for (const EToolMotion motion : kToolMotions)
        EXPECT_EQ(m_kToolWindow.View(motion).m_spkShown, m_kTool.Motion(motion).motionRoot);
    EXPECT_NE(Bone(EToolMotion::Target, "LFoot"), Bone(EToolMotion::Result, "LFoot")) << "two trees";
    EXPECT_EQ(m_kTool.LastFrameOf(EToolMotion::Source), 2);
    EXPECT_EQ(m_kTool.Status(), "walk.bvh: 3 frames");
}

TEST_F(ToolTest, WhatDoesNotLoadLeavesTheMotionBefore)
{
    LoadSource();
    Add("hip", "LowerTorso");
    const std::string lines = Lines();
    const auto* const before = m_kTool.Motion(EToolMotion::Source).motionRoot.Get();
    Write("bad.bvh", "HIERARCHY\nROOT hip\n{\n");
    Write("bad.htr", "no header");
    for (const char* file : {"bad.bvh", "bad.htr", "none.bvh", "map.orn"})
    {
        SCOPED_TRACE(file);
        Click(kToolLoadSource, file);
        EXPECT_EQ(m_kTool.Status().find(file), 0u) << m_kTool.Status();
        Click(kToolLoadTarget, file);
        EXPECT_EQ(m_kTool.Status().find(file), 0u) << m_kTool.Status();
        EXPECT_FALSE(m_kTool.DropFile(EToolMotion::Source, m_kFolder.Path(file)));
        EXPECT_EQ(m_kTool.Motion(EToolMotion::Source).motionRoot.Get(), before);
        EXPECT_EQ(Lines(), lines);
    }
}

TEST_F(ToolTest, ButtonsTakeClicksWhenTheyCanDoSomething)
{
    const std::set<int> always{kToolClose, kToolLoadSource, kToolLoadTarget};
    EXPECT_EQ(Enabled(), always);
    Click(kToolAddToMap);
    Click(kToolConvert);
    EXPECT_FALSE(m_kTool.IsConverted()) << "a disabled button does nothing";

    Click(kToolLoadTarget, "data/base.htr");
    std::set<int> withTarget = always;
    withTarget.insert(kToolSaveResult);
    EXPECT_EQ(Enabled(), withTarget) << "before any conversion";

    LoadSource();
    std::set<int> withTrees = withTarget;
    withTrees.insert({kToolAddToMap, kToolLoadMap});
    EXPECT_EQ(Enabled(), withTrees);
    Click(kToolAddToMap);
    EXPECT_EQ(Lines(), "") << "without a bone selected in both trees";

    Add("hip", "LowerTorso");
    std::set<int> withLines = withTrees;
    withLines.insert({kToolDelete, kToolDeleteAll, kToolSaveMap, kToolConvert});
    EXPECT_EQ(Enabled(), withLines);
    m_kTool.SelectLine(0);
    EXPECT_TRUE(m_kTool.IsEnabled(kToolDetail));
    Click(kToolClose);
    EXPECT_TRUE(m_kToolWindow.m_bClosed);
}

TEST_F(ToolTest, AConversionMovesTheResultAsTheLinesSay)
{
    LoadSource(4);
    LoadMap(kMap);
    for (const int play : {1019, 1024, 1029})
        Click(play);
    EXPECT_TRUE(m_kTool.IsPlaying());
    Click(kToolConvert);
    EXPECT_FALSE(m_kTool.IsPlaying()) << "all views stand";
    EXPECT_TRUE(m_kTool.IsConverted());
    EXPECT_EQ(m_kTool.Status().find("Converted 4 frames; the pelvis bones"), 0u)
        << "one of them is not fixed";
    EXPECT_EQ(m_kTool.LastFrameOf(EToolMotion::Result), 3);
    EXPECT_EQ(m_kToolWindow.View(EToolMotion::Result).m_spkShown,
              m_kTool.Motion(EToolMotion::Result).motionRoot);
    const Vec3 path = ResultAt("LowerTorso", 3).Translation() - ResultAt("LowerTorso", 0).Translation();
    EXPECT_GT(path.z, 0.0f) << "the source walks along Z";

    LoadMap("hip <---> LowerTorso .|* LPelvis|* RPelvis|lThigh <---> LThigh .|lShin <---> LCalf .|lFoot "
            "<---> LFoot .|"
            "rThigh <---> RThigh .|rShin <---> RCalf .|rFoot <---> RFoot .|");
    Click(kToolConvert);
    EXPECT_EQ(m_kTool.Status().find("pelvis"), std::string::npos) << m_kTool.Status();
    EXPECT_LT(DegreesBetween(NormalizedRows(ResultAt("LCalf", 0)), NormalizedRows(ResultAt("LThigh", 0))),
              0.05)
        << "no leg is planted: the knee is as straight as the source's";
}

TEST_F(ToolTest, AConversionAddsThePositionToWhereTheSkeletonStands)
{
    LoadSource(4);
    const std::string rows = "|hip <---> LowerTorso .|";
    LoadMap("Walk|Position 0,0,0" + rows);
    Click(kToolConvert);
    const Vec3 origin = ResultAt("LowerTorso", 0).Translation();
    LoadMap("Walk|Position 1,2,3" + rows);
    Click(kToolConvert);
    EXPECT_LT(Vec3Length(ResultAt("LowerTorso", 0).Translation() - origin - Vec3{1, 2, 3}), 1e-3);
    EXPECT_GT(Vec3Length(origin), 1.0);
}

TEST_F(ToolTest, AConversionDoesNotDependOnTheOneBefore)
{
    LoadSource(4);
    LoadMap("hip <---> LowerTorso .|lFoot <---> LFoot .|");
    Click(kToolConvert);
    const std::vector<Mat4> once = ResultPoses();
    LoadMap(kMap);
    Click(kToolConvert);
    EXPECT_NE(ResultPoses(), once);
    LoadMap("hip <---> LowerTorso .|lFoot <---> LFoot .|");
    Click(kToolConvert);
    EXPECT_EQ(ResultPoses(), once);

    Write("max.bvh", BvhText(kMaxBones));
    Click(kToolLoadTarget, "max.bvh");
    Add("hip", "Bip01");
    Click(kToolConvert);
    const std::vector<Mat4> kept = ResultPoses();
    std::filesystem::remove(m_kFolder.Path("max.bvh"));
    Click(kToolConvert);
    EXPECT_EQ(m_kTool.Status().find("max.bvh: "), 0u) << m_kTool.Status();
    EXPECT_EQ(ResultPoses(), kept);
}

TEST_F(ToolTest, TransportButtonsMoveTheirOwnViewOnly)
{
    LoadSource(4);
    Click(kToolLoadTarget, "walk.bvh");
    int start =
        1010; // behind it: six more, then back, stop, play and forward; the other views have theirs in a row
    for (const EToolMotion motion : kToolMotions)
    {
        SCOPED_TRACE(start);
        const int back = start == 1010 ? 1017 : start + 1;
        const auto frameAfter = [&](int button) {
            Click(button);
            return m_kTool.FrameOf(motion);
        };
        EXPECT_EQ(frameAfter(back + 3), 1);
        EXPECT_EQ(frameAfter(back + 3), 2);
        EXPECT_EQ(frameAfter(back), 1);
        Click(back + 2);
        EXPECT_TRUE(m_kTool.Advance());
        EXPECT_EQ(frameAfter(back + 1), 2);
        EXPECT_FALSE(m_kTool.Advance());
        EXPECT_EQ(frameAfter(start), 0);
        Click(back + 2);
        while (m_kTool.Advance())
            ;
        EXPECT_EQ(m_kTool.FrameOf(motion), 0) << "played once";
        start = back + 4;
    }
}

TEST_F(ToolTest, TheResultIsSavedAtItsFixedScale)
{
    LoadSource(120);
    LoadMap(kMap);
    Click(kToolConvert);
    Click(kToolSaveResult, "out.htr");
    EXPECT_EQ(m_kToolWindow.m_kAsked.filter, "Anm Files (*.htr;*.bvh) |*.htr;*.bvh||");
    EXPECT_EQ(m_kTool.Status(), "Saved out.htr, every sixtieth frame");
    EXPECT_NE(ReadText(m_kFolder.Path("out.htr")).find("NumFrames 2\n"), std::string::npos)
        << "one frame of sixty";

    const std::tuple<const char*, const char*, const char*> refused[] = {
        {"data/base.htr", "out.bvh", "Not saved: out.bvh: results are written as .htr only"},
        {"data/base.htr", "none/out.htr", "Not saved: out.htr: the file cannot be written"},
        {"walk.bvh", "new.htr", "Not saved: new.htr: the target has no rest pose"},
    };
    for (const auto& [target, path, says] : refused)
    {
        Click(kToolLoadTarget, target);
        Click(kToolSaveResult, path);
        EXPECT_EQ(m_kTool.Status().find(says), 0u) << m_kTool.Status();
        EXPECT_FALSE(Exists(path));
    }
}

TEST_F(ToolTest, AMissingFixedSkeletonIsSaid)
{
    DeleteFile(m_kFolder.Path("data/base.htr"));
    LoadSource();
    EXPECT_EQ(m_kTool.Status().find("base.htr: "), 0u) << m_kTool.Status();
    EXPECT_FALSE(m_kTool.IsEnabled(kToolLoadMap));
    EXPECT_FALSE(m_kTool.IsEnabled(kToolSaveResult));
    Click(kToolLoadTarget, "walk.bvh");
    EXPECT_TRUE(m_kTool.IsEnabled(kToolLoadMap));
}

} // namespace gw
