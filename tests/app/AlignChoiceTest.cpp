// A source re-expressed relative to another rest pose for one conversion.

#include "CFileConversion.h"
#include "ContentFixture.h"

namespace gw {

// The project's example walk, with its profile spoiled: the left thigh's rotation fits no rest pose.
class AlignTest : public ContentTest
{
protected:
    AlignTest()
    {
        Write("data/base.htr", ReadBytes(GAITWRIGHT_PROJECT "/assets/base.htr"));
        WriteProfile("LThigh 0,90,40");
        EXPECT_EQ(Open(m_kWalk), 1);
        m_kWindow.TakeCalls();
    }
    void WriteProfile(const std::string& thigh) const
    {
        std::string text = ReadBytes(GAITWRIGHT_PROJECT "/assets/PoserBVH.prf");
        const std::string plain = "LThigh 0,0,0";
        text.replace(text.find(plain), plain.size(), thigh);
        Write("data/PoserBVH.prf", "Poser" + text.substr(text.find('\n'))); // the name in the list
    }
    std::string Converted(bool align)
    {
        m_kContent.SetChoices({align, false});
        m_kWindow.m_kAnswers[139] = EAnswer::No;
        EXPECT_EQ(m_kContent.ConvertMotion(), 1);
        EXPECT_TRUE(m_kContent.WriteResult(m_kFolder.Path("result.htr")));
        return Read("result.htr");
    }

    const std::string m_kWalk = GAITWRIGHT_PROJECT "/examples/walk.bvh";
};

TEST_F(AlignTest, HoldsForOneConversionAndLeavesTheSource)
{
    const std::string plain = Converted(false);
    EXPECT_EQ(m_kWindow.TakeWords(), "turned-at-rest lThigh") << "the worst one";
    const std::string aligned = Converted(true);
    EXPECT_EQ(m_kWindow.TakeWords(), "");
    EXPECT_NE(plain, aligned);
    EXPECT_EQ(Converted(true), aligned) << "the same again";
    EXPECT_EQ(Converted(false), plain) << "and as if it had never been";

    WriteProfile("LThigh 0,0,0");
    m_kContent.PickStockProfile();
    EXPECT_EQ(Converted(true), aligned) << "a row's rotations have no say";
}

TEST_F(AlignTest, WritesTheSourceAsAMotionThatOpensAgain)
{
    CFileConversion conversion(m_kFolder.Path("data/"), {true, false}, [](const Notice&) {});
    ASSERT_TRUE(conversion.LoadSource(m_kWalk) && conversion.LoadTarget() &&
                conversion.UseProfile(m_kFolder.Path("data/PoserBVH.prf")) &&
                conversion.WriteAligned(m_kFolder.Path("a.bvh")));
    ASSERT_EQ(Open(m_kFolder.Path("a.bvh")), 1);
    EXPECT_EQ(m_kWindow.m_kEnabled["convert"], true);
    EXPECT_NE(Read("a.bvh").find("Frames: 67"), std::string::npos) << "the last frame too";
}

TEST_F(ContentTest, AnAlignedConversionNeedsABody)
{
    ASSERT_EQ(Open(Write("legs.bvh", BvhText(kPoserBones))), 1);
    m_kContent.SetChoices({true, false});
    EXPECT_EQ(m_kContent.ConvertMotion(), 0);
    EXPECT_EQ(m_kWindow.TakeWords(), "no-body, 144");
}

} // namespace gw
