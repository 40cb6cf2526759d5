// What stands in a page, whatever the names and the numbers of a motion.

#include "CConversionPage.h"
#include "CMarkup.h"
#include "CPagePart.h"
#include "ConvertedMotion.h"
#include "KeyFigures.h"
#include "PairedFigures.h"
#include "TempFolder.h"

#include <gtest/gtest.h>
#include <limits>

namespace gw {
namespace {

constexpr int kFrames = 40;

// Two figures, what was measured of them, and the page about them.
class CMadeConversion
{
public:
    explicit CMadeConversion(const FigurePose& pose, int frameCount = kFrames)
    {
        m_kMotion.source = "takes/made.bvh";
        m_kMotion.result = "made.Kinetra";
        m_kMotion.profile = "Made";
        m_kMeasured.sums = m_kFigures.Measure(kStill, pose, frameCount);
        m_kMeasured.detail = m_kFigures.detail;
        m_kMotion.sourceClip = m_kFigures.sourceClip;
        m_kMotion.resultClip = m_kFigures.resultClip;
        m_kMotion.measured = &m_kMeasured;
    }
    ConvertedMotion& Motion() { return m_kMotion; }
    MeasuredConversion& Measured() { return m_kMeasured; }
    CMadeFigure& Source() { return m_kFigures.source; }

    std::string Page() const
    {
        CConversionPage page;
        AddTo(page, 1, 1);
        return Written(page);
    }
    // Adds the row that the record would give, and the details.
    void AddTo(CConversionPage& page, size_t number, size_t detailCount) const
    {
        CPagePart part(number, detailCount);
        part.Show(m_kMotion);
        PageRow row{.source = m_kMotion.source, .outcome = "converted", .profile = m_kMotion.profile};
        for (const KeyFigure& figure : KeyFiguresOf(m_kMeasured.sums, m_kMeasured.detail))
            row.figures.push_back(figure.value);
        page.Add(row);
        page.AddDetails(part);
    }
    static std::string Written(CConversionPage& page)
    {
        const CTempFolder folder;
        EXPECT_TRUE(page.Write(folder.Path("page.html")));
        return ReadBytes(folder.Path("page.html"));
    }

private:
    PairedFigures m_kFigures;
    ConvertedMotion m_kMotion;
    MeasuredConversion m_kMeasured;
};

size_t Count(const std::string& text, std::string_view word)
{
    size_t count = 0;
    for (size_t at = text.find(word); at != text.npos; at = text.find(word, at + 1))
        ++count;
    return count;
}

bool Has(const std::string& text, std::string_view word)
{
    return text.find(word) != text.npos;
}

const FigurePose kFaulty = [](CMadeFigure& figure, int frame) {
    figure.Turn("LForearm", kVec3UnitZ, frame == 20 ? 60.0 : 1.0);
    figure.Turn("LCalf", kVec3UnitX, frame == 35 ? 14.0 : 0.0);
};

} // namespace

TEST(Page, ShowsTheFramesOfMadeFaultsWithBothSkeletons)
{
    const std::string page = CMadeConversion(kFaulty).Page();
    EXPECT_TRUE(Has(page, "<b>Frame 35</b> LFoot is planted but slides 96.8 mm farther than in the source"));
    EXPECT_TRUE(Has(page, "<b>Frame 35</b> the toe of LFoot is planted but slides"));
    EXPECT_TRUE(Has(page, "<b>Frame 35</b> the knee above LFoot jumps by 14.0°"));
    const std::string directions = CMadeConversion([](CMadeFigure& figure, int frame) {
                                       figure.Turn("LForearm", kVec3UnitZ, frame == 20 ? 60.0 : 1.0);
                                   }).Page();
    EXPECT_TRUE(Has(directions, "<b>Frame 20</b> mean error of the main bones"));
    EXPECT_TRUE(Has(directions, "largest at LForearm, 60.0°"));
    const size_t frames = Count(page, "<article>");
    EXPECT_EQ(frames, 3u);
    EXPECT_EQ(Count(page, "aria-label=\"source, from"), 2 * frames);
    EXPECT_EQ(Count(page, "aria-label=\"result, from"), 2 * frames);
    EXPECT_EQ(Count(page, "<circle class=\"bad\""), 4 * frames);
    for (const char* word : {"http", "<link", "@import", "url(", "src="})
        EXPECT_FALSE(Has(page, word)) << word << ": a page needs nothing from anywhere";
    EXPECT_TRUE(Has(page, "prefers-color-scheme: dark"));
}

TEST(Page, HostileNamesAreTextAndNothingElse)
{
    const char* const hostile = "<b>\"'&\x1b\xff\xc2\x85</style>";
    CMadeConversion made(kFaulty);
    made.Motion().source = made.Motion().result = made.Motion().profile = hostile;
    made.Source().Bone("LForearm").SetName(hostile);
    for (BoneMeasures& bone : made.Measured().sums.bones)
        bone.source = bone.target = hostile;
    for (FootMeasures& foot : made.Measured().sums.feet)
        foot.source = foot.target = hostile;
    const std::string page = made.Page();
    EXPECT_EQ(Count(page, "</style>"), 1u);
    EXPECT_TRUE(Has(page, "&lt;b&gt;&quot;&#39;&amp;\\x1b\\xff\\xc2\\x85&lt;/style&gt;"));
    EXPECT_FALSE(Has(page, "\x1b") || Has(page, "\xff"));
    EXPECT_EQ(CMarkup().Name(std::string(100000, 'x')).Text().size(), 300 + std::string_view("…").size());
}

TEST(Page, ShowsTheWaysOfBothHipsInOneScale)
{
    const auto walking = [](CMadeFigure& figure, int frame) {
        figure.Move("LowerTorso", {0.0f, 0.0f, 50.0f * static_cast<float>(frame)});
    };
    const std::string page = CMadeConversion(walking).Page();
    const size_t way = page.find("class=\"curve result\"", page.find("Path of the hips"));
    ASSERT_NE(way, page.npos);
    EXPECT_EQ(page.substr(page.find(" d=", way), 14), " d=\"M150.0 0.0") << "begins at the far edge";
    EXPECT_TRUE(Has(page, "L150.0 130.0\"")) << "and ends at the near one";
}

TEST(Page, SaysHowAFigureStandsInWords)
{
    const auto poor = [](CMadeFigure& figure, int) { figure.Turn("LowerTorso", kVec3UnitX, 40.0); };
    EXPECT_TRUE(Has(CMadeConversion(poor).Page(), "✕ Poor"));
    const std::string same = CMadeConversion(kStill).Page();
    EXPECT_TRUE(Has(same, "✓ Good"));
    EXPECT_TRUE(Has(same, "– None")) << "a motion that stands still has no jitter to compare";
    EXPECT_FALSE(Has(same, "Poor"));
    EXPECT_FALSE(Has(same, "Worst frames"));
    EXPECT_EQ(Count(same, "</dt><dd>How") + Count(same, "</dt><dd>The same"), KeyFigureCount());
}

TEST(Page, LongMotionsStaySmall)
{
    CMadeConversion made(kFaulty, 2);
    ConversionDetail& detail = made.Measured().detail;
    for (std::vector<float>* curve : {&detail.meanError, &detail.largestError, &detail.feet[0].sourceKnee,
                                      &detail.feet[0].resultSole, &detail.feet[1].sourceSole})
    {
        curve->resize(100000);
        for (size_t f = 0; f < curve->size(); ++f)
            (*curve)[f] = static_cast<float>(f * 7919 % 997);
    }
    detail.largestBone.resize(100000);
    const std::string page = made.Page();
    EXPECT_LT(page.size(), 300000u);
    EXPECT_GT(page.size(), 50000u) << "and they are there";
}

// What a damaged motion may bring: the page is made, and draws none of it.
TEST(Page, NumbersThatAreNoneDoNoHarm)
{
    for (const float odd : {std::numeric_limits<float>::quiet_NaN(), std::numeric_limits<float>::infinity(),
                            std::numeric_limits<float>::max()})
    {
        const auto lost = [=](CMadeFigure& figure, int frame) {
            figure.Turn("LForearm", kVec3UnitZ, 20.0);
            figure.Move("LCalf", frame == 7 ? Vec3{odd, 0.0f, odd} : kVec3Zero);
        };
        const auto everywhere = [=](CMadeFigure& figure, int) { figure.Move("LowerTorso", {odd, odd, odd}); };
        for (const std::string& page :
             {CMadeConversion(lost, 12).Page(), CMadeConversion(everywhere, 3).Page()})
        {
            EXPECT_TRUE(page.ends_with("</html>\n"));
            EXPECT_FALSE(Has(page, "nan") || Has(page, "inf ") || Has(page, "inf\"")) << odd;
        }
    }
}

TEST(Page, SeveralMotionsBeginWithATableOfTheWorst)
{
    const auto bad = [](CMadeFigure& figure, int) { figure.Turn("LowerTorso", kVec3UnitX, 40.0); };
    CMadeConversion good(kStill);
    CMadeConversion poor(bad);
    good.Motion().source = "good.bvh";
    poor.Motion().source = "poor.bvh";
    CConversionPage page;
    good.AddTo(page, 1, 20);
    poor.AddTo(page, 2, 20);
    page.Add({.source = "broken.bvh", .outcome = "failed", .cause = "line 7: odd", .causeKind = "odd lines"});
    page.Add({.source = "late.bvh", .outcome = "left"});
    const std::string text = CMadeConversion::Written(page);
    EXPECT_LT(text.find("broken.bvh<small>line 7: odd<"), text.find("\"poor.bvh\""));
    EXPECT_LT(text.find("\"poor.bvh\""), text.find("\"good.bvh\""));
    EXPECT_EQ(Count(text, "broken.bvh") + Count(text, "late.bvh"), 1u) << "not in the table";
    EXPECT_EQ(Count(text, "<section id=\"motion"), 2u);
}

// The column of the default conversion appears only if that conversion was measured.
TEST(Page, SetsTheChoicesAgainstThePlainRules)
{
    CMadeConversion plain([](CMadeFigure& figure, int) { figure.Turn("LForearm", kVec3UnitZ, 33.0); });
    CMadeConversion chosen(kStill);
    EXPECT_FALSE(Has(chosen.Page(), "default"));
    chosen.Motion().plain = &plain.Measured();
    const std::string page = chosen.Page();
    EXPECT_TRUE(Has(page, "<th>default °</th>"));
    EXPECT_TRUE(Has(page, "<td>33.000</td>"));
}

} // namespace gw
