#include "ContentFixture.h"

#include "Paths.h"

namespace gw {

namespace {

std::string Joined(const std::set<std::string>& words)
{
    std::string text;
    for (const std::string& word : words)
        text += (text.empty() ? "" : " ") + word;
    return text;
}

} // namespace

// Files are good sources, but for those with a mark behind their name: "!" is broken, "?" has other bones,
// "/" is a folder. The boxes are message ids.
TEST_F(ContentTest, BatchRuns)
{
    constexpr const char* kAbandoned = " - Batch Converting 2 : b";
    const struct
    {
        const char* what;
        int job;
        const char* profile; // selected before the run
        const char* files;
        int answer;
        const char* boxes;
        const char* count; // what the summary begins with
        const char* written;
        const char* title; // at the end, behind the product's name
    } rows[] = {
        {"all good",                 1, "Poser", "a.bvh b.BVH c.bvh",  1, "146",     "3 ", "a.htr b.htr c.htr",       ""                         },
        {"no file of the kind",      1, "Poser", "a.htr",              0, "",        "",   "a.htr",                   ""                         },
        {"one broken",               1, "Poser", "a.bvh b.bvh! c.bvh", 1, "138 146", "1 ", "a.htr",                   ""                         },
        {"one misfit",               1, "Poser", "a.bvh b.bvh? c.bvh", 0, "144",     "",   "a.htr",                   kAbandoned                 },
        {"no profile selected",      1, "",      "a.bvh",              0, "144",     "",   "",                        " - Batch Converting 1 : a"},
        {"one cannot be written",    1, "Poser", "a.bvh b.bvh b.htr/", 1, "146",     "1 ", "a.htr",                   ""                         },
        {"packages need no profile", 2, "",      "a.htr b.HTR!",       1, "148",     "2 ", "a.htr a.orn b.HTR b.orn", ""                         },
    };
    for (const auto& row : rows)
    {
        SCOPED_TRACE(row.what);
        const std::string folder = std::string(row.what) + '/';
        for (std::string file : Words(row.files))
        {
            const char mark =
                std::string_view("!?/").find(file.back()) != std::string_view::npos ? file.back() : ' ';
            file.resize(file.size() - (mark == ' ' ? 0 : 1));
            if (mark == '/')
                CreateFolder(m_kFolder.Path(folder + file));
            else
                Write(folder + file, mark == '!' ? "x" : BvhText(mark == '?' ? kMaxBones : kPoserBones));
        }
        m_kWindow.m_kList.SetCurSel(-1);
        if (*row.profile)
            SelectProfile(row.profile);
        m_kWindow.m_kBoxes = {""};
        m_kWindow.m_kTitles = {"Gaitwright v2.0"};
        m_kWindow.m_kFolderAnswer = CFolderChoice{m_kFolder.Path(folder), row.job};
        m_kWindow.TakeCalls();
        EXPECT_EQ(m_kContent.RunBatch(), row.answer);
        std::set<std::string> boxes;
        for (const std::string& call : m_kWindow.TakeCalls())
        {
            if (call.starts_with("box "))
                boxes.insert(call.substr(4));
        }
        EXPECT_EQ(Joined(boxes), row.boxes);
        EXPECT_EQ(m_kWindow.m_kBoxes.back().find(row.count), 0u) << m_kWindow.m_kBoxes.back();
        EXPECT_EQ(m_kWindow.m_kTitles.back(), std::string("Gaitwright v2.0") + row.title);
        EXPECT_EQ(m_kWindow.m_iWaits, 0);
        std::set<std::string> written;
        for (const char* extension : {".htr", ".orn"})
        {
            for (const std::string& file : FilesInFolder(m_kFolder.Path(folder), extension))
                written.insert(file);
        }
        EXPECT_EQ(Joined(written), row.written);
    }
}

TEST_F(ContentTest, APackageThatCannotBeReadEndsTheRunWithoutAWord)
{
    Write("run/a.htr", "text");
    // A link to nowhere is listed by no one, so the file goes between listing and reading.
    m_kWindow.m_kFolderAnswer = CFolderChoice{m_kFolder.Path("run/"), 2};
    m_kWindow.m_kOnBatchFile = [](const std::string& path) { DeleteFile(path); };
    m_kWindow.TakeCalls();
    EXPECT_EQ(m_kContent.RunBatch(), 0);
    EXPECT_EQ(m_kWindow.TakeCalls(), std::vector<std::string>{"folder in "});
    EXPECT_EQ(m_kWindow.m_kTitles.back(), "Gaitwright v2.0 - Batch Converting 1 : a");
    ASSERT_EQ(m_kWindow.m_kReports.size(), 1u);
    EXPECT_EQ(m_kWindow.m_kReports[0].code, "not-found");
}

TEST_F(ContentTest, ABatchKeepsTheFramesWhereASaveMultipliesThem)
{
    Write("run/a.bvh", BvhText(kPoserBones));
    SelectProfile("Poser");
    m_kWindow.m_kFolderAnswer = CFolderChoice{m_kFolder.Path("run"), 1};
    ASSERT_EQ(m_kContent.RunBatch(), 1);
    EXPECT_NE(Read("run/a.htr").find("NumFrames 3"), std::string::npos);
    EXPECT_EQ(m_kPlatform.m_kSettings["MotionSource"], m_kFolder.Path("run/"));
    EXPECT_FALSE(m_kContent.IsConverted()) << "a run leaves the flags alone";
    EXPECT_FALSE(m_kWindow.m_kEnabled["apply"]);
}

TEST_F(ContentTest, ABatchReadsNoShift)
{
    OpenAndConvert();
    SaveAs("hand.mot");
    m_kContent.UseProfileFile(m_kFolder.Path("data/PoserBVH.prf"));
    Write("run/a.bvh", BvhText(kPoserBones));
    m_kWindow.m_kKeys = {EKey::LeftShift};
    m_kWindow.m_kFolderAnswer = CFolderChoice{m_kFolder.Path("run"), 1};
    ASSERT_EQ(m_kContent.RunBatch(), 1);
    const std::string batch = Read("run/a.htr");
    m_kContent.ConvertMotion(); // now with Shift
    m_kContent.WriteResult(m_kFolder.Path("shift.htr"));
    EXPECT_NE(batch.substr(batch.find("[LThigh]")),
              Read("shift.htr").substr(Read("shift.htr").find("[LThigh]")));
}

} // namespace gw
