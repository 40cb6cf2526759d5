// Faults that only the poses show, each in an otherwise healthy walk, and harmless look-alikes.

#include "CMotionFile.h"
#include "Examined.h"
#include "MadeWalk.h"
#include "Skeleton.h"

#include <gtest/gtest.h>
#include <tuple>

namespace gw {
namespace {

constexpr size_t kHipX = 0;
constexpr size_t kHandY = 47; // Yrotation of LeftForeArm

std::string WithValues(std::string text, int frame, size_t column, std::initializer_list<const char*> values)
{
    for (const char* value : values)
    {
        const size_t line = LineOfFrame(text, frame++);
        text = WithLine(text, line, WithValue(LineOf(text, line), column, value));
    }
    return text;
}

std::string SidesSwapped(const std::string& text)
{
    return AllReplaced(AllReplaced(AllReplaced(text, "Left", "?"), "Right", "Left"), "?", "Right");
}

TEST(PoseFaults, AreFound)
{
    WalkStyle doubled;
    doubled.repeatsOffsets = true;
    WalkStyle floating;
    floating.hipOffset = true;
    WalkStyle below;
    below.rootBelow = true;
    WalkStyle slow;
    slow.rate = 120.0;
    slow.declaredRate = 24.0;
    slow.frames = 400;
    WalkStyle fast;
    fast.declaredRate = 120.0;
    const std::string walk = MadeWalk();
    const std::tuple<const char*, std::string, const char*> rows[] = {
        {"a joint that turns away for a frame", WithValues(walk, 40, kHandY, {"75"}), "170 spike"},
        {"one that does for two", WithValues(walk, 40, kHandY, {"75", "74"}), "170 spike"},
        {"a hip that jumps aside for a frame", WithValues(walk, 40, kHipX, {"30"}), "170 spike"},
        {"positions that repeat the offsets", MadeWalk(doubled), "8 doubled-offset"},
        {"a height that stands twice", MadeWalk(floating), "4 doubled-hip-offset"},
        {"a root that does not move", MadeWalk(below), "2 still-root"},
        {"left for right", SidesSwapped(walk), "30 sides-swapped"},
        {"120 frames a second said to be 24", MadeWalk(slow), "129 wrong-rate"},
        {"30 frames a second said to be 120", MadeWalk(fast), "129 wrong-rate"},
    };
    for (const auto& [what, text, found] : rows)
        EXPECT_EQ(CExamined(text).Found(), found) << what;
}

TEST(PoseFaults, AreNotFoundInWhatLooksLikeThem)
{
    WalkStyle other;
    other.rate = other.declaredRate = 47.0; // an unusual rate, but correct
    other.frames = 150;
    const std::string walk = MadeWalk();
    WalkStyle brief;
    brief.frames = 5;
    const std::tuple<const char*, std::string> rows[] = {
        {"a turn in a file too short to tell", WithValues(MadeWalk(brief), 1, kHandY, {"75"})},
        {"a quick turn that stays", WithValues(walk, 87, kHandY, {"75", "75", "75"})},
        {"a strike: out and back on the way", WithValues(walk, 40, kHandY, {"30", "65", "75", "60", "25"})},
        {"a turn given as one more whole turn", WithValues(walk, 40, kHandY, {"360"})},
        {"an odd rate that is right", MadeWalk(other)},
    };
    for (const auto& [what, text] : rows)
        EXPECT_EQ(CExamined(text).Found(), "") << what;
}

TEST(PoseFaults, OfOffsetsAreMendedToBonesOfTheirLength)
{
    WalkStyle style;
    style.sixChannels = true;
    const std::string healthy = MadeWalk(style);
    style.repeatsOffsets = true;
    EXPECT_TRUE(CExamined(MadeWalk(style)).Mended() == healthy);

    // A single joint with different positions is left alone.
    const auto withHead = [](std::string text, std::initializer_list<const char*> position) {
        for (size_t axis = 0; axis < 3; ++axis)
        {
            for (int frame = 0; frame < 90; ++frame)
                text = WithValues(text, frame, 6 * 20 + axis, {position.begin()[axis]});
        }
        return text;
    };
    const char* const nowhere = "0.000000";
    EXPECT_TRUE(CExamined(withHead(MadeWalk(style), {nowhere, nowhere, nowhere})).Mended() == healthy);
    EXPECT_EQ(CExamined(withHead(healthy, {nowhere, "10.0", "1.0"})).Found(), "");

    style = {};
    style.hipOffset = true;
    CExamined floating(MadeWalk(style));
    const CTempFolder folder;
    WriteBytes(folder.Path("a.bvh"), floating.Mended());
    EXPECT_EQ(CExamined(ReadBytes(folder.Path("a.bvh"))).Found(), "");
    CMotionFile motion;
    ASSERT_TRUE(motion.Load(folder.Path("a.bvh")));
    EXPECT_FLOAT_EQ(motion.motionRoot->m_kWorldMatrix.Translation().y, 90.0f);
}

// A spike is replaced by interpolating between its neighbors, and no other value changes.
TEST(PoseFaults, OfOneFrameAreMendedInPlace)
{
    const std::string walk = MadeWalk();
    const std::string mended = CExamined(WithValues(walk, 40, kHandY, {"75"})).Mended();
    const size_t line = LineOfFrame(walk, 40);
    EXPECT_TRUE(WithLine(mended, line, "") == WithLine(walk, line, ""));
    EXPECT_NEAR(ValueOf(mended, 40, kHandY), ValueOf(walk, 40, kHandY), 1e-5);
    // The shorter way if angles jump by a whole turn.
    std::string turned = walk;
    for (int frame = 30; frame < 50; ++frame)
        turned = WithValues(turned, frame, kHandY, {frame < 40 ? "178" : frame == 40 ? "75" : "-178"});
    EXPECT_NEAR(std::fabs(ValueOf(CExamined(turned).Mended(), 40, kHandY)), 180.0, 1e-5);
    CExamined two(WithValues(walk, 40, kHandY, {"75", "74"}));
    EXPECT_FALSE(two.Exam().Findings().MendsAny());
}

TEST(PoseFaults, OfTheRateNameTheRightOne)
{
    WalkStyle style;
    style.declaredRate = 120.0;
    const std::vector<Finding> found = CExamined(MadeWalk(style)).Exam().Findings().Sorted();
    ASSERT_EQ(found.size(), 1u);
    const int usual = std::stoi(found[0].name.substr(found[0].name.rfind(' ')));
    EXPECT_GT(usual, 20);
    EXPECT_LT(usual, 45);
}

TEST(Healthy, FilesOfEveryStyleHaveNoFault)
{
    const auto styled = [](void (*change)(WalkStyle&)) {
        WalkStyle style;
        change(style);
        return MadeWalk(style);
    };
    const std::string walk = MadeWalk();
    const std::tuple<const char*, std::string> rows[] = {
        {"as it is", walk},
        {"CR LF", AllReplaced(walk, "\n", "\r\n")},
        {"tabs between the values", AllReplaced(walk, " 0.000000", "\t0.000000")},
        {"a blank behind each row", AllReplaced(walk, "\n", " \n")},
        {"no line end at the end", walk.substr(0, walk.size() - 1)},
        {"empty lines at the end", walk + "\n\n"},
        {"words before the hierarchy", "Root of all motions\n" + walk},
        {"names of other languages", Replaced(walk, "LeftToeBase", "\xc3\x9f\xe8\xb6\xb3")},
        {"scientific numbers", styled([](WalkStyle& s) { s.scientific = true; })},
        {"six channels on each joint", styled([](WalkStyle& s) { s.sixChannels = true; })},
        {"Z up", styled([](WalkStyle& s) { s.zUp = true; })},
        {"metres", styled([](WalkStyle& s) { s.unit = 0.01f; })},
        {"inches", styled([](WalkStyle& s) { s.unit = 1.0f / 2.54f; })},
        {"no toes", styled([](WalkStyle& s) { s.toes = false; })},
        {"one frame", styled([](WalkStyle& s) { s.frames = 1; })},
        {"100 frames a second", styled([](WalkStyle& s) { s.rate = s.declaredRate = 100; })},
    };
    for (const auto& [what, text] : rows)
    {
        SCOPED_TRACE(what);
        CExamined examined(text);
        EXPECT_EQ(examined.Found(), "");
        EXPECT_TRUE(examined.Loads());
        EXPECT_TRUE(examined.Mended() == text) << "nothing to mend";
    }
}

TEST(Healthy, MixedOrdersAreOnlyNoted)
{
    CExamined mixed(Replaced(MadeWalk(), "Zrotation Xrotation", "Xrotation Zrotation", "LeftHand"));
    EXPECT_EQ(mixed.Found(), "74 mixed-channels");
    EXPECT_FALSE(mixed.Exam().Findings().HasFaults());
}

TEST(Healthy, FilesTellTheirFacts)
{
    WalkStyle style;
    style.unit = 10.0f;
    style.zUp = true;
    CExamined examined(MadeWalk(style));
    const MotionFacts& facts = examined.Exam().Facts().value();
    EXPECT_EQ(facts.unit, "millimetres");
    EXPECT_NEAR(facts.leg, 820.0, 0.01);
    EXPECT_EQ(facts.up, "Z");
    EXPECT_EQ(facts.restPose, ERestPose::TPose);
    EXPECT_EQ(facts.body, EBodySource::Names);
    EXPECT_EQ(facts.jointCount, 21u);
    EXPECT_EQ(facts.frameCount, 90u);
}

} // namespace
} // namespace gw
