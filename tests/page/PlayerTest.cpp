// The data of the player: what its script will find.

#include "Player.h"
#include "CMarkup.h"
#include "PairedFigures.h"

#include <gtest/gtest.h>
#include <regex>

namespace gw {
namespace {

std::string PlayerOf(int frameCount)
{
    CMadeFigure source;
    CMadeFigure result;
    MeasuredConversion measured;
    ConvertedMotion motion;
    motion.sourceClip = source.Record(frameCount, [](CMadeFigure&, int) {});
    motion.resultClip = result.Record(frameCount, [](CMadeFigure& figure, int frame) {
        figure.Move("LowerTorso", {10.0f * static_cast<float>(frame), 0.0f, 0.0f});
    });
    motion.measured = &measured;
    measured.sums =
        MeasureConversion(motion.sourceClip, motion.resultClip, PairByName(source, result), &measured.detail);
    CMarkup page;
    const ChartMark marks[] = {{3, 1}};
    AppendPlayer(page, motion, marks);
    return page.Text();
}

long NumberAfter(const std::string& text, const std::string& key)
{
    const size_t at = text.find(key);
    return at == text.npos ? -1 : std::stol(text.substr(at + key.size()));
}

} // namespace

TEST(Player, StoresEveryPointOfEveryFrame)
{
    const std::string page = PlayerOf(40);
    const long points = NumberAfter(page, "\"points\":");
    ASSERT_GT(points, 10);
    EXPECT_EQ(NumberAfter(page, "\"stride\":"), 1);
    static const std::regex kPositions("\"positions\":\"([^\"]*)\"");
    std::smatch positions;
    ASSERT_TRUE(std::regex_search(page, positions, kPositions));
    EXPECT_EQ(positions[1].length(), (std::ptrdiff_t{2} * 3 * points * 40 + 2) / 3 * 4)
        << "two bytes per coordinate";
    EXPECT_NE(page.find("\"marks\":[[3,1]]"), page.npos);
    EXPECT_NE(page.find(",1]"), page.npos) << "bones of the left side";
    EXPECT_NE(page.find(",2]"), page.npos) << "bones of the right side";
}

TEST(Player, StoresFewerFramesOfALongMotion)
{
    const std::string page = PlayerOf(20000);
    EXPECT_GT(NumberAfter(page, "\"stride\":"), 1);
    EXPECT_LT(page.size(), 2'500'000u);
    EXPECT_EQ(PlayerOf(1), "") << "a single pose does not move";
}

TEST(Markup, EncodesBytesAndTextsForScripts)
{
    EXPECT_EQ(CMarkup().Base64("").Base64("f").Base64("fo").Base64("foo\xff").Text(), "Zg==Zm8=Zm9v/w==");
    EXPECT_EQ(CMarkup().JsonText("a\"\\</script>\x01").Text(),
              R"("a\u0022\u005c\u003c/script\u003e\u005cx01")");
}

} // namespace gw
