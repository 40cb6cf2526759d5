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

TEST(PoseFaults, AreFoundAndNotWhatLooksLikeThem)
{
    const std::string walk = MadeWalk();
    const std::string sidesSwapped =
        AllReplaced(AllReplaced(AllReplaced(walk, "Left", "?"), "Right", "Left"), "?", "Right");
    const std::tuple<const char*, std::string, const char*> rows[] = {
        {"a joint that turns away for a frame", WithValues(walk, 40, kHandY, {"75"}), "170 spike"},
        {"one that does for two", WithValues(walk, 40, kHandY, {"75", "74"}), "170 spike"},
        {"a hip that jumps aside for a frame", WithValues(walk, 40, kHipX, {"30"}), "170 spike"},
        {"positions that repeat the offsets", MadeWalk({.repeatsOffsets = true}), "8 doubled-offset"},
        {"a height that stands twice", MadeWalk({.hipOffset = true}), "4 doubled-hip-offset"},
        {"a root that does not move", MadeWalk({.rootBelow = true}), "2 still-root"},
        {"left for right", sidesSwapped, "30 sides-swapped"},
        {"120 frames a second said to be 24", MadeWalk({.frames = 400, .rate = 120.0, .declaredRate = 24.0}),
         "129 wrong-rate"},
        {"30 frames a second said to be 120", MadeWalk({.declaredRate = 120.0}), "129 wrong-rate"},
        {"a turn in a file too short to tell", WithValues(MadeWalk({.frames = 5}), 1, kHandY, {"75"}), ""},
        {"a quick turn that stays", WithValues(walk, 87, kHandY, {"75", "75", "75"}), ""},
        {"a strike: out and back on the way", WithValues(walk, 40, kHandY, {"30", "65", "75", "60", "25"}),
         ""},
        {"a turn given as one more whole turn", WithValues(walk, 40, kHandY, {"360"}), ""},
        {"an odd rate that is right", MadeWalk({.frames = 150, .rate = 47.0, .declaredRate = 47.0}), ""},
    };
    for (const auto& [what, text, found] : rows)
        EXPECT_EQ(CExamined(text).Found(), found) << what;
}

TEST(PoseFaults, OfOffsetsAreMendedToBonesOfTheirLength)
{
    const std::string healthy = MadeWalk({.sixChannels = true});
    const std::string doubled = MadeWalk({.repeatsOffsets = true});
    EXPECT_TRUE(CExamined(doubled).Mended() == healthy);

    // A single joint with different positions is left alone.
    const auto withHead = [](std::string text, const std::vector<const char*>& position) {
        for (size_t axis = 0; axis < 3; ++axis)
            text = WithValues(text, 0, 6 * 20 + axis, std::vector(90, position[axis]));
        return text;
    };
    const char* const nowhere = "0.000000";
    EXPECT_TRUE(CExamined(withHead(doubled, {nowhere, nowhere, nowhere})).Mended() == healthy);
    EXPECT_EQ(CExamined(withHead(healthy, {nowhere, "10.0", "1.0"})).Found(), "");

    CExamined floating(MadeWalk({.hipOffset = true}));
    const CExamined standing(floating.Mended());
    EXPECT_EQ(standing.Found(), "");
    CMotionFile motion;
    ASSERT_TRUE(motion.Load(standing.Path()));
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
    std::string turned = WithValues(walk, 30, kHandY, std::vector<const char*>(10, "178"));
    turned =
        WithValues(WithValues(turned, 40, kHandY, {"75"}), 41, kHandY, std::vector<const char*>(9, "-178"));
    EXPECT_NEAR(std::fabs(ValueOf(CExamined(turned).Mended(), 40, kHandY)), 180.0, 1e-5);
    CExamined two(WithValues(walk, 40, kHandY, {"75", "74"}));
    EXPECT_FALSE(two.Exam().Findings().MendsAny());
}

TEST(PoseFaults, OfTheRateNameTheRightOne)
{
    const std::vector<Finding> found =
        CExamined(MadeWalk({.declaredRate = 120.0})).Exam().Findings().Sorted();
    ASSERT_EQ(found.size(), 1u);
    const int usual = std::stoi(found[0].name.substr(found[0].name.rfind(' ')));
    EXPECT_GT(usual, 20);
    EXPECT_LT(usual, 45);
}

TEST(Healthy, FilesOfEveryStyleHaveNoFault)
{
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
        {"scientific numbers", AllReplaced(walk, "9.000000", "0.9e+01")},
        {"six channels on each joint", MadeWalk({.sixChannels = true})},
        {"Z up", MadeWalk({.zUp = true})},
        {"metres", MadeWalk({.unit = 0.01f})},
        {"inches", MadeWalk({.unit = 1.0f / 2.54f})},
        {"no toes", MadeWalk({.toes = false})},
        {"one frame", MadeWalk({.frames = 1})},
        {"100 frames a second", MadeWalk({.rate = 100, .declaredRate = 100})},
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

TEST(Healthy, FilesTellTheirFacts)
{
    CExamined examined(MadeWalk({.unit = 10.0f, .zUp = true}));
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
