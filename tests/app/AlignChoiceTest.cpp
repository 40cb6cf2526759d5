// A source re-expressed relative to another rest pose for one conversion.

#include "CFileConversion.h"
#include "ContentFixture.h"

namespace gw {
namespace {

std::string Replaced(std::string text, const std::string& what, const std::string& with)
{
    const size_t place = text.find(what);
    EXPECT_NE(place, std::string::npos) << what;
    return place == std::string::npos ? text : text.replace(place, what.size(), with);
}

// The walker, with a neck above its hip.
std::string NeckedBvh()
{
    const std::string neck = "JOINT neck\n{\nOFFSET 0 50 0\nCHANNELS 3 Zrotation Xrotation Yrotation\nEnd "
                             "Site\n{\nOFFSET 0 10 0\n}\n}\n";
    std::string text = Replaced(BvhText(kPoserBones), "JOINT lThigh", neck + "JOINT lThigh");
    for (size_t row = text.find("0 80 "); row != std::string::npos; row = text.find("0 80 ", row + 20))
    {
        size_t behindRoot = row;
        for (int value = 0; value < 6; ++value)
            behindRoot = text.find(' ', behindRoot) + 1;
        text.insert(behindRoot, "0 0 0 ");
    }
    return text;
}

std::string NeckedTarget(const std::string& base)
{
    std::string text = Replaced(base, "NumSegments 10", "NumSegments 11");
    text = Replaced(text, "Waist LowerTorso\n", "Waist LowerTorso\nNeck Waist\n");
    text = Replaced(text, "LPelvis 0 -400 0", "Neck 0 400 0 0 0 0 400\nLPelvis 0 -400 0");
    return Replaced(text, "[LPelvis]", "[Neck]\n1 0 0 0 0 0 0 1\n[LPelvis]");
}

// A profile whose rotations fit no rest pose.
std::string SpoiledMap()
{
    const std::string text = BoneMapText("Poser", kPoserBones) + "neck <---> Neck 0,0,0,1,2,3\n";
    return Replaced(text, "LThigh 0,0,0", "LThigh 0,90,40");
}

} // namespace

class AlignTest : public ContentTest
{
protected:
    std::string Converted(bool align)
    {
        m_kContent.SetChoices({align, false});
        m_kWindow.m_kAnswers[139] = EAnswer::No;
        EXPECT_EQ(m_kContent.ConvertMotion(), 1);
        EXPECT_TRUE(m_kContent.WriteResult(m_kFolder.Path("result.htr")));
        return Read("result.htr");
    }
    void OpenNecked()
    {
        Write("data/base.htr", NeckedTarget(Read("data/base.htr")));
        Write("data/PoserBVH.prf", SpoiledMap());
        ASSERT_EQ(Open(Write("walk.bvh", NeckedBvh())), 1);
    }
};

TEST_F(AlignTest, HoldsForOneConversionAndLeavesTheSource)
{
    OpenNecked();
    const std::string plain = Converted(false);
    const std::string aligned = Converted(true);
    EXPECT_NE(plain, aligned);
    EXPECT_EQ(Converted(true), aligned) << "the same again";
    EXPECT_EQ(Converted(false), plain) << "and as if it had never been";

    Write("data/PoserBVH.prf", Replaced(SpoiledMap(), "LThigh 0,90,40", "LThigh 0,0,0"));
    m_kContent.PickStockProfile();
    EXPECT_EQ(Converted(true), aligned) << "a row's rotations have no say";
}

TEST_F(AlignTest, SaysOfRowsThatTurnLimbsAtRestUnlessAligned)
{
    OpenNecked();
    m_kWindow.TakeCalls();
    Converted(false);
    EXPECT_EQ(m_kWindow.TakeWords(), "turned-at-rest lThigh") << "the worst one";
    Converted(true);
    EXPECT_EQ(m_kWindow.TakeWords(), "");
}

TEST_F(AlignTest, NeedsABody)
{
    ASSERT_EQ(Open(Write("legs.bvh", BvhText(kPoserBones))), 1);
    m_kWindow.TakeCalls();
    m_kContent.SetChoices({true, false});
    EXPECT_EQ(m_kContent.ConvertMotion(), 0);
    EXPECT_EQ(m_kWindow.TakeWords(), "no-body, 144");
}

TEST_F(AlignTest, WritesTheSourceAsAMotionThatOpensAgain)
{
    OpenNecked();
    CFileConversion conversion(m_kFolder.Path("data/"), {true, false}, [](const Notice&) {});
    ASSERT_TRUE(conversion.LoadSource(m_kFolder.Path("walk.bvh")) && conversion.LoadTarget() &&
                conversion.UseProfile(m_kFolder.Path("data/PoserBVH.prf")) &&
                conversion.WriteAligned(m_kFolder.Path("a.bvh")));
    ASSERT_EQ(Open(m_kFolder.Path("a.bvh")), 1);
    EXPECT_EQ(m_kWindow.m_kEnabled["convert"], true);
    EXPECT_NE(Read("a.bvh").find("Frames: 3"), std::string::npos) << "the last frame too";
}

} // namespace gw
