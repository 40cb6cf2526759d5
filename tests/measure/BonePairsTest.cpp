#include "BonePairs.h"

#include "CMadeFigure.h"
#include "TempFolder.h"

#include <gtest/gtest.h>

namespace gw {
namespace {

std::string PairText(const BonePair& pair)
{
    return std::string(pair.source->NameView()) + ">" + pair.target->GetName();
}

} // namespace

TEST(BonePairs, ProfileRowsBecomePairsAndMisfits)
{
    const CMadeFigure figure;
    CNode* const root = &figure.Bone("LowerTorso");
    const CTempFolder folder;
    const std::string path = folder.Path("map.prf");
    WriteBytes(path, "A map\nFrameRate 30\nPosition 0 0 0\n"
                     "LowerTorso <---> LowerTorso 0,0,0,1,2,3\n"
                     "* LThigh . .1,2,3\n"
                     "Neck <---> Head 0,0,0,1,2,3\n"
                     "Tail <---> Head 0,0,0,1,2,3\n"
                     "rcalf <---> RCalf 0,90,0,1,2,3\n"
                     "Head <---> Head 0,0,0,1,2,3\n");
    std::vector<BonePair> pairs;
    std::vector<MissingBone> missing;
    ASSERT_TRUE(ReadBonePairs(path, root, root, pairs, missing));

    ASSERT_EQ(pairs.size(), 3u);
    EXPECT_EQ(PairText(pairs[0]), "LowerTorso>LowerTorso");
    EXPECT_EQ(PairText(pairs[1]), "Head>Head") << "the later row counts";
    EXPECT_EQ(PairText(pairs[2]), "RCalf>RCalf");
    ASSERT_EQ(missing.size(), 1u);
    EXPECT_EQ(missing[0].line, 7u);
    EXPECT_EQ(missing[0].name, "Tail");
    EXPECT_EQ(missing[0].side, ESkeletonSide::Source);

    EXPECT_FALSE(ReadBonePairs(folder.Path("gone.prf"), root, root, pairs, missing));
    EXPECT_EQ(pairs.size(), 3u) << "a profile that is gone changes nothing";
}

} // namespace gw
