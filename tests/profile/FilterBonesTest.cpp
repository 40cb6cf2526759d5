#include "FilterBones.h"

#include "ProfileFixture.h"

#include <gmock/gmock.h>

namespace gw {

using testing::ElementsAre;
using testing::IsEmpty;

namespace {

std::vector<std::string> Found(const CBoneTree& tree, std::string_view text)
{
    std::vector<std::string> names;
    for (const int item : FilterBones(tree, text))
        names.push_back(tree.Text(item));
    return names;
}

} // namespace

TEST(FilterBones, UnmappedBonesComeFirst)
{
    const Ref<CNode> root = MakeChain({"Hips", "LeftArm", "leftForearm", "Head"});
    CBoneTree tree(1);
    tree.Rebuild(root.Get());
    EXPECT_THAT(Found(tree, "ARM"), ElementsAre("LeftArm", "leftForearm"));
    tree.Mark(tree.Find("LeftArm"), true);
    EXPECT_THAT(Found(tree, "arm"), ElementsAre("leftForearm", "LeftArm"));
    EXPECT_THAT(Found(tree, "e"), ElementsAre("leftForearm", "Head", "LeftArm")) << "in the tree's order";
    EXPECT_THAT(Found(tree, ""), ElementsAre("Hips", "leftForearm", "Head", "LeftArm"));
    EXPECT_THAT(Found(tree, "leg"), IsEmpty());
    EXPECT_EQ(BonePath(tree, tree.Find("leftForearm")), "Hips / LeftArm");
}

} // namespace gw
