// A run's state for the next run, and its visible progress.

#include "CContentHash.h"
#include "CProgressBar.h"
#include "CReportFile.h"
#include "CResumeState.h"
#include "Paths.h"
#include "TempFolder.h"

#include <gtest/gtest.h>
#include <tuple>

namespace gw {

TEST(CContentHash, TellsApartWhichBytesBelongToWhat)
{
    const CTempFolder folder;
    WriteBytes(folder.Path("ab"), "ab");
    WriteBytes(folder.Path("empty"), "");
    const std::string digits[] = {
        CContentHash().AddText("ab").AddText("c").Digits(),
        CContentHash().AddText("a").AddText("bc").Digits(),
        CContentHash().AddText("abc").Digits(),
        CContentHash().AddText("ab").Digits(),
        CContentHash().AddFile(folder.Path("ab")).Digits(),
        CContentHash().AddFile(folder.Path("empty")).Digits(),
        CContentHash().AddFile(folder.Path("none")).Digits(),
        CContentHash().Digits(),
    };
    for (size_t i = 0; i < std::size(digits); ++i)
    {
        EXPECT_EQ(digits[i].size(), 32u);
        for (size_t j = 0; j < i; ++j)
            EXPECT_NE(digits[i], digits[j]) << i << " and " << j;
    }
}

TEST(CReportFile, HalfALineOfADeadWriterIsClosedFirst)
{
    const CTempFolder folder;
    const std::tuple<const char*, const char*, CReportFile::EStart, const char*> rows[] = {
        {"nothing there", "", CReportFile::EStart::AtEnd, "new\n"},
        {"whole lines", "old\n", CReportFile::EStart::AtEnd, "old\nnew\n"},
        {"half a line", "old\nha", CReportFile::EStart::AtEnd, "old\nha\nnew\n"},
        {"to be replaced", "old\nha", CReportFile::EStart::Empty, "new\n"},
    };
    for (const auto& [what, before, start, after] : rows)
    {
        SCOPED_TRACE(what);
        WriteBytes(folder.Path("report"), before);
        CReportFile report;
        ASSERT_TRUE(report.Open(folder.Path("report"), start));
        EXPECT_TRUE(report.AddLine("new"));
        EXPECT_EQ(ReadBytes(folder.Path("report")), after); // immediately, not when it is closed
    }
    CReportFile full;
    EXPECT_FALSE(full.Open("/dev/full", CReportFile::EStart::Empty) && full.AddLine("lost"));
    EXPECT_FALSE(CReportFile().Open(folder.Path("none/report"), CReportFile::EStart::Empty));
}

TEST(CResumeState, SeveralRunsKnowOfEachOtherAndTornLinesOfNothing)
{
    const CTempFolder folder;
    const std::string odd = "odd\xff\tname.Kinetra";
    CResumeState first;
    ASSERT_TRUE(first.Open(folder.Path(), "shard-0"));
    EXPECT_TRUE(first.AddReady("ready.Kinetra", "digits", "1.5"));
    EXPECT_TRUE(first.AddMade(odd, "key", "digits", "1.5", R"("outcome":"converted")"));
    CResumeState other;
    ASSERT_TRUE(other.Open(folder.Path(), "shard-1"));
    EXPECT_TRUE(other.AddMade("made.Kinetra", "key", "old digits", "1.5", "old"));
    EXPECT_TRUE(other.AddSynced());
    EXPECT_TRUE(other.AddMade("made.Kinetra", "key", "digits", "2.5", "new"));
    WriteBytes(folder.Path(".gaitwright.resume.torn.jsonl"),
               "{\"output\":\"torn.Kin\n[[[[\n\n17\n{\"output\":5,\"key\":\"key\"}\n");
    WriteBytes(folder.Path(".gaitwright.resume.old.jsonl"),
               "{\"output\":\"begun.Kinetra\"}\n{\"output\":\"old.Kinetra\"}\n{\"output\":\"old.Kinetra\","
               "\"key\":\"key\",\"digits\":\"digits\",\"told\":\"told\"}\n");
    WriteBytes(folder.Path("other.jsonl"), "{\"output\":\"strange.Kinetra\"}\n");

    CResumeState next;
    next.Read(folder.Path());
    const auto told = [&](const std::string& output, const char* key, const char* digits) {
        const std::string* text = next.FindTold(output, key, digits);
        return text ? *text : std::string("nothing");
    };
    EXPECT_EQ(told(odd, "key", "digits"), R"("outcome":"converted")");
    EXPECT_EQ(told("made.Kinetra", "key", "digits"), "new");
    EXPECT_EQ(told("made.Kinetra", "key", "old digits"), "old");
    EXPECT_EQ(told("made.Kinetra", "other key", "digits"), "nothing");
    EXPECT_EQ(told("ready.Kinetra", "key", "digits"), "nothing");
    EXPECT_EQ(told("made.Kinetra", "key", ""), "nothing");
    EXPECT_TRUE(next.Knows("begun.Kinetra"));
    EXPECT_TRUE(next.HasUnsynced());
    const struct
    {
        const char* what;
        const char* output;
        const char* digits;
        const char* modified;
        bool own;
    } rows[] = {
        {"about to take its place", "ready.Kinetra", "digits", "9.9", true},
        {"torn by a power failure", "ready.Kinetra", "torn", "1.5", true},
        {"edited", "ready.Kinetra", "edited", "9.9", false},
        {"an older result", "made.Kinetra", "old digits", "9.9", true},
        {"edited, with its time put back", "made.Kinetra", "edited", "1.5", false},
        {"torn behind the last sync", "made.Kinetra", "torn", "2.5", true},
        {"made by an earlier version", "old.Kinetra", "digits", "1.5", true},
        {"edited since then", "old.Kinetra", "edited", "", false},
        {"only begun by it", "begun.Kinetra", "edited", "", false},
    };
    for (const auto& row : rows)
        EXPECT_EQ(next.IsOwn(row.output, row.digits, row.modified), row.own) << row.what;
    EXPECT_TRUE(next.Knows(odd));
    EXPECT_FALSE(next.Knows("torn.Kin"));
    EXPECT_FALSE(next.Knows("strange.Kinetra"));
}

TEST(ProgressLine, SaysWhatIsKnownInTheWidthThereIs)
{
    const std::tuple<const char*, RunProgress, size_t, const char*> rows[] = {
        {"nothing known", {0, 8, 0, 0.0}, 80, "[>                       ] 0/8"},
        {"half", {5, 10, 0, 2.5}, 80, "[============>           ] 5/10  2.5/s  2s left"},
        {"minutes", {0, 10000, 0, 100.0}, 80, "[>                       ] 0/10000  100.0/s  1m40s left"},
        {"hours", {0, 10000, 0, 1.6}, 80, "[>                       ] 0/10000  1.6/s  1h44m left"},
        {"failures", {9, 10, 3, 1.0}, 80, "[=====================>  ] 9/10  1.0/s  1s left, 3 failed"},
        {"the end", {10, 10, 0, 4.0}, 80, "[========================] 10/10  4.0/s  0s left"},
        {"no work", {0, 0, 0, 0.0}, 80, "[========================] 0/0"},
        {"little room", {5, 10, 0, 2.5}, 10, "[========="},
        {"all but never",
         {0, 1000000, 0, 0.0001},
         80,
         "[>                       ] 0/1000000  0.0/s  277777h46m left"},
    };
    for (const auto& [what, progress, width, line] : rows)
        EXPECT_EQ(ProgressLine(progress, width), line) << what;
}

} // namespace gw
