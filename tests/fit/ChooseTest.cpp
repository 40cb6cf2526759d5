#include "CNamedBody.h"
#include "ChooseProfile.h"
#include "Paths.h"
#include "SharedPrefix.h"
#include "Skeleton.h"
#include "TempFolder.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <tuple>
#include <utility>

namespace gw {
namespace {

constexpr std::string_view kAssets = GAITWRIGHT_ASSETS;

constexpr BodyChange kFingers{"a hand of fingers", "", BodyChange::AsTheyAre, true, true};

std::vector<std::string> StockPaths()
{
    std::vector<std::string> paths;
    for (const std::string& file : FilesInFolder(std::string(kAssets), ".prf"))
        paths.push_back(std::string(kAssets) + file);
    return paths;
}

class Choose : public testing::Test
{
protected:
    Choose() { EXPECT_TRUE(m_kTarget.Load(std::string(kAssets) + "base.htr")); }

    std::vector<ProfileChoice> Of(CNode& source, const std::vector<std::string>& paths = StockPaths())
    {
        std::vector<ProfileChoice> all = ChooseProfile(paths, source, *m_kTarget.motionRoot);
        const auto some = ChooseProfile(paths, source, *m_kTarget.motionRoot, EJudged::First);
        EXPECT_EQ(some.empty() ? "" : some.front().path, all.empty() ? "" : all.front().path);
        EXPECT_EQ(some.empty() ? "" : some.front().profile.name, all.empty() ? "" : all.front().profile.name);
        return all;
    }
    /// Writes a profile that drives the hips, with additional rows.
    std::string Profile(const std::string& name, const std::string& rows)
    {
        std::string path = m_kFolder.Path(name + ".prf");
        WriteBytes(path, name + "\nFrameRate 30\nPosition 0 0 0\nHips <---> LowerTorso 0,0,0,1,2,3\n" + rows);
        return path;
    }
    static std::vector<std::string> Names(const std::vector<ProfileChoice>& choices)
    {
        std::vector<std::string> names;
        names.reserve(choices.size());
        for (const ProfileChoice& choice : choices)
            names.push_back(choice.profile.name);
        return names;
    }

    CTempFolder m_kFolder;
    CMotionFile m_kTarget;
};

TEST_F(Choose, OfEqualRowsTheRestPoseDecides)
{
    const std::pair<BodyChange, const char*> rows[] = {
        {{"a hand of one bone"}, "MotionBuilder / HumanIK (2 spine joints)"},
        {kFingers, "MotionBuilder / HumanIK (2 spine joints, fingers)"},
    };
    for (const auto& [change, named] : rows)
    {
        SCOPED_TRACE(change.what);
        const ProfileChoice best = Of(CNamedBody(kHumanIK, change).Root()).front();
        EXPECT_EQ(best.profile.name, named);
        EXPECT_EQ(best.verdict.sureness, ESureness::Sure);
        EXPECT_LT(best.verdict.turn, 5.0);
    }
}

TEST_F(Choose, AHandThatWouldStandAcrossIsTold)
{
    const CNamedBody body(kHumanIK, kFingers);
    const std::vector<ProfileChoice> choices = Of(body.Root(), {std::string(kAssets) + "HumanIK02.prf"});
    std::vector<std::string> turned;
    for (const ProfileDoubt& doubt : choices.front().verdict.doubts)
        turned.emplace_back(doubt.kind == EDoubt::Turned ? doubt.joint : "another doubt");
    EXPECT_THAT(turned, testing::ElementsAre("LeftHand", "RightHand"));
    EXPECT_EQ(choices.front().verdict.sureness, ESureness::Likely);
}

TEST_F(Choose, MoreRowsGoFirstThenTheOrderGivenThenWhatFitsInPart)
{
    const CNamedBody body(kHumanIK, {"plain"});
    const std::string chest = "Spine1 <---> UpperTorso 0,0,0,1,2,3\n";
    const std::vector<std::string> paths = {
        Profile("half", chest + "Skull <---> Head 0,0,0,1,2,3\n"),
        Profile("few", ""),
        Profile("tail", chest + "Neck <---> Head 0\nNeck <---> Tail 0\nSpine <---> Tip 0\n"),
        Profile("first", chest),
        m_kFolder.Path("none.prf"),
        Profile("second", chest),
        Profile("third", "Bone1 <---> Head 0\nBone2 <---> Neck 0\nBone3 <---> LHand 0\n"),
    };
    EXPECT_THAT(Names(Of(body.Root(), paths)),
                testing::ElementsAre("first", "second", "few", "tail", "half", "third"));
}

TEST_F(Choose, AProfileWithoutTheRootBoneFitsNothing)
{
    const CNamedBody body(kHumanIK, {"plain"});
    const std::string path = m_kFolder.Path("rootless.prf");
    WriteBytes(path, "Rootless\nSpine1 <---> UpperTorso 0,0,0\n");
    EXPECT_FALSE(Of(body.Root(), {path}).front().match.IsWhole());
    WriteBytes(path, std::string("Zero\0\n* \n\n<--->\n", 16));
    EXPECT_FALSE(Of(body.Root(), {path}).front().match.IsWhole());
}

TEST_F(Choose, APrefixIsTriedOnlyWhereNothingFits)
{
    const CNamedBody body(kHumanIK, {"a prefix", "Model_"});
    std::vector<std::string> paths = StockPaths();
    EXPECT_TRUE(Of(body.Root(), paths).front().adapted);
    WriteBytes(m_kFolder.Path("own.prf"), "Own\nModel_Hips <---> LowerTorso 0\n");
    paths.push_back(m_kFolder.Path("own.prf"));
    const std::vector<ProfileChoice> choices = Of(body.Root(), paths);
    EXPECT_EQ(choices.front().profile.name, "Own");
    EXPECT_EQ(std::ranges::count(choices, true, &ProfileChoice::adapted), 0);
}

TEST_F(Choose, APrefixOfTheProfileMayBeMissingInTheNames)
{
    const CNamedBody body(kHumanIK, {"plain"});
    ProfileRows profile;
    ASSERT_TRUE(ReadProfileRows(std::string(kAssets) + "HumanIK02.prf", profile));
    profile.rows = WithPrefix(profile.rows, "", "Figure:");
    WriteBytes(m_kFolder.Path("prefixed.prf"), TextOf(profile));
    const ProfileChoice best = Of(body.Root(), {m_kFolder.Path("prefixed.prf")}).front();
    EXPECT_TRUE(best.match.IsWhole());
    EXPECT_THAT(best.profile.name, testing::EndsWith(", no prefix"));
}

TEST_F(Choose, TheSourceStandsAsItStoodBefore)
{
    const CNamedBody body(kHumanIK, {"plain"});
    std::vector<CNode*> nodes = NodesOf(body.Root());
    for (size_t i = 0; i < nodes.size(); ++i) // as some frame may have left them
        nodes[i]->m_kMatrix.m[12] = nodes[i]->m_kWorldMatrix.m[13] = static_cast<float>(i);
    Of(body.Root());
    for (size_t i = 0; i < nodes.size(); ++i)
    {
        EXPECT_EQ(nodes[i]->m_kMatrix.m[12], static_cast<float>(i)) << nodes[i]->NameView();
        EXPECT_EQ(nodes[i]->m_kWorldMatrix.m[13], static_cast<float>(i)) << nodes[i]->NameView();
    }
}

TEST(SharedPrefix, NearlyAllNamesMustHaveIt)
{
    using Names = std::vector<std::string>;
    const std::tuple<const char*, std::string, Names, Names> rows[] = {
        {"none", "", {}, {}},
        {"an underscore", "Model_", {}, {"Model_"}},
        {"a namespace in a namespace", "a:b:", {}, {"a:b:", "a:"}},
        {"no separator", "mixamorig", {}, {"mixamorig"}},
        {"a root outside", "Model_", {"Armature"}, {"Model_"}},
        {"many outside", "Model_", {"Sword", "Shield", "Horse"}, {}},
    };
    for (const auto& [what, prefix, others, shared] : rows)
    {
        std::vector<std::string> names = others;
        for (const char* name :
             {"Hips", "Spine", "Neck", "Head", "LeftArm", "RightArm", "LeftLeg", "RightLeg"})
            names.push_back(prefix + name);
        EXPECT_EQ(SharedPrefixes(names), shared) << what;
    }
    EXPECT_TRUE(SharedPrefixes(std::vector<std::string>{"a_b", "a_c"}).empty());
    EXPECT_TRUE(SharedPrefixes({}).empty());
}

// Real motions of many programs: the chosen profile, or the reason for none. The original stock profiles are
// used whenever they fit, so nothing is said about which joint is which where all is well.
TEST_F(Choose, RealMotions)
{
    if (SharedDataFolder().empty())
        GTEST_SKIP() << "no shared data here";
    const auto load = [](const std::string& name, CMotionFile& source) {
        EXPECT_TRUE(source.Load(SharedDataFolder() + "bvh/" + name + ".bvh"));
    };
    // name: empty if nothing fits
    const std::tuple<const char*, const char*, ESureness> rows[] = {
        {"bandai_walk_normal_002", "Bandai Namco (2 spine joints)", ESureness::Sure},
        {"cmu_cgspeed_example", "CMU, MotionBuilder names (3 spine joints, fingers)", ESureness::Sure},
        {"daz3d_genesis", "DAZ Genesis 3 and 8 (4 spine joints, fingers)", ESureness::Sure},
        {"fair1_dab", "MotionBuilder / HumanIK (4 spine joints, leaning, fingers)", ESureness::Likely},
        {"fingers60_crlf", "MotionBuilder / HumanIK (4 spine joints, curved, fingers)", ESureness::Likely},
        {"geno_stance", "MotionBuilder / HumanIK (4 spine joints, leaning)", ESureness::Likely},
        {"julia_example", "", ESureness::Sure},
        {"m21_female_walk", "MotionBuilder / HumanIK, 21 joints (2 spine joints)", ESureness::Likely},
        {"makehuman_tpose", "", ESureness::Sure},
        {"makehuman_walk1", "", ESureness::Sure},
        {"mixamo_freebvh", "Mixamo (3 spine joints, fingers)", ESureness::Sure},
        {"pymo_walk_120hz", "MotionBuilder / HumanIK without neck (1 spine joint)", ESureness::Likely},
        {"rokoko_jesse_dance", "Rokoko Studio, HumanIK (3 spine joints)", ESureness::Likely},
        {"rotation_first_root", "", ESureness::Sure},
        {"two_joints", "", ESureness::Sure},
        {"walk01_leftupleg", "MotionBuilder / HumanIK (2 spine joints, leaning)", ESureness::Sure},
        {"xzy_leftupleg", "MotionBuilder / HumanIK (4 spine joints)", ESureness::Likely},
    };
    for (const auto& [file, name, sureness] : rows)
    {
        SCOPED_TRACE(file);
        CMotionFile source;
        load(file, source);
        const ProfileChoice best = Of(*source.motionRoot).front();
        EXPECT_EQ(best.match.IsWhole() ? best.profile.name : "", name);
        EXPECT_EQ(best.verdict.sureness, sureness);
    }
    const std::pair<const char*, const char*> old[] = {
        {"cmu1_jumping_jacks", "MaxBVH.prf"}, {"mocapbank_lefthip", "MaxBVH.prf"},
        {"yxz_lefthip", "MaxBVH.prf"},        {"poser_boxing", "PoserBVH.prf"},
        {"poser_pose1", "PoserBVH.prf"},      {"poser_tpose_one_frame", "PoserBVH.prf"},
    };
    for (const auto& [file, profile] : old)
    {
        CMotionFile source;
        load(file, source);
        const ProfileChoice choice = Of(*source.motionRoot, {std::string(kAssets) + profile}).front();
        EXPECT_TRUE(choice.match.IsWhole()) << file;
        for (const ProfileDoubt& doubt : choice.verdict.doubts)
            EXPECT_FALSE(IsOfRoles(doubt.kind)) << file << ", " << doubt.joint;
    }
}

} // namespace
} // namespace gw
