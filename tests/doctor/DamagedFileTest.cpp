// Any bytes yield a result, and an unreadable file is never reported as healthy.

#include "CMotionFile.h"
#include "Examined.h"
#include "MadeWalk.h"
#include "Paths.h"

#include <gtest/gtest.h>
#include <map>
#include <random>
#include <tuple>

namespace gw {
namespace {

// The reader's result and the examination must not contradict each other.
void ExpectConsistent(const std::string& text)
{
    CExamined examined(text);
    const CFindings& findings = examined.Exam().Findings();
    CMotionFile motion;
    const bool loads = motion.Load(examined.Path());
    EXPECT_EQ(loads, examined.Exam().Facts().has_value());
    EXPECT_TRUE(loads || findings.HasErrors());
    for (const Finding& warning : motion.Record().Warnings())
        EXPECT_TRUE(findings.HasFaults() || warning.reason == EFailure::RestPose);
    if (!findings.MendsAny())
        return;
    CExamined copy(examined.Mended());
    EXPECT_TRUE(copy.Loads() || copy.Exam().Findings().HasErrors());
    EXPECT_TRUE(copy.Loads() || !loads) << examined.Found() << " -> " << copy.Found();
}

TEST(DamagedFiles, CutAnywhereAreNoHealthyOnes)
{
    const std::string walk = MadeWalk({.frames = 6});
    const std::string head = walk.substr(0, walk.find(LineOf(walk, LineOfFrame(walk, 1))));
    for (size_t length = 0; length < head.size();
         length += length < 40 || length + 400 > head.size() ? 1 : 11)
    {
        SCOPED_TRACE(length);
        CExamined cut(walk.substr(0, length));
        EXPECT_TRUE(cut.Exam().Findings().HasErrors());
        EXPECT_FALSE(cut.Loads());
    }
}

TEST(DamagedFiles, WithBytesChangedAreAnswered)
{
    const std::string walk = MadeWalk({.frames = 6});
    constexpr std::string_view kBytes{"\0\n\r\t ,.-+{}0eE#\xff\xc2\xa0n", 19};
    std::mt19937 random(7);
    for (int round = 0; round < 300; ++round)
    {
        SCOPED_TRACE(round);
        std::string text = walk;
        for (int change = 0; change < 1 + round % 4; ++change)
        {
            const size_t at = random() % text.size();
            if (round % 3 == 0)
                text.erase(at, 1 + random() % 40);
            else
                text[at] = kBytes[random() % kBytes.size()];
        }
        ExpectConsistent(text);
    }
}

TEST(DamagedFiles, ThatHoldNoMotionAreTold)
{
    const std::tuple<const char*, std::string, const char*> rows[] = {
        {"nothing", "", "0 missing-section"},
        {"another text", "solid cube\nfacet\n", "2 missing-section"},
        {"bytes", std::string(300, '\x01'), "0 not-text"},
        {"a motion without hierarchy", "MOTION\nFrames: 1\n0 0 0\n", "1 no-root"},
        {"a hierarchy without joints", "HIERARCHY\nMOTION\nFrames: 1\n", "2 no-root"},
    };
    for (const auto& [what, text, found] : rows)
    {
        SCOPED_TRACE(what);
        CExamined examined(text);
        EXPECT_EQ(examined.Found(), found);
        EXPECT_TRUE(examined.Exam().Findings().HasErrors());
    }
}

// Files of many programs, whose findings were each verified. They are too large for this repository.
TEST(RealFiles, HaveTheFaultsThatTheyHave)
{
    const std::map<std::string, const char*> faults = {
        {"bandai_walk_normal_002.bvh", "12 doubled-offset"},
        {"cmu_cgspeed_example.bvh", "411 spike"}, // the right thumb is rotated by 177 degrees for two frames
        {"geno_stance.bvh", "4 doubled-hip-offset, 8 doubled-offset"},
        {"neuron_milad.bvh", "4 doubled-hip-offset, 8 doubled-offset, 350 empty-line-before-frames"},
        {"poser_boxing.bvh", "4 doubled-hip-offset, 8 doubled-offset"},
        {"poser_pose1.bvh", "128 surplus-rows"},
        {"pymo_walk_120hz.bvh", "4 doubled-hip-offset"},
        {"rokoko_jesse_dance.bvh", "4 doubled-hip-offset"},
        {"walk01_leftupleg.bvh", "4 doubled-hip-offset"},
    };
    if (SharedDataFolder().empty())
        GTEST_SKIP() << "no shared data here";
    const std::string folder = SharedDataFolder() + "bvh/";
    for (const std::string& name : FilesInFolder(folder, ".bvh"))
    {
        SCOPED_TRACE(name);
        CExamined examined(ReadBytes(folder + name));
        const bool healthy = !examined.Exam().Findings().HasFaults(); // notes are not faults
        EXPECT_EQ(healthy ? "" : examined.Found(), faults.contains(name) ? faults.at(name) : "");
        const bool mends = examined.Exam().Findings().MendsAny();
        EXPECT_FALSE(mends && CExamined(examined.Mended()).Exam().Findings().HasFaults());
    }
}

} // namespace
} // namespace gw
