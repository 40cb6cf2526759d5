#include "ContentFixture.h"

#include "Paths.h"

namespace gw {
namespace {

std::string Joined(const std::set<std::string>& words)
{
    std::string text;
    for (const std::string& word : words)
        text.append(text.empty() ? "" : " ").append(word);
    return text;
}

} // namespace

class BatchTest : public ContentTest
{
protected:
    // Files are valid sources, except those with a mark after their name: "!" is broken, "?" has other bones,
    // "/" is a folder.
    void WriteFiles(const std::string& folder, const char* files) const
    {
        for (const std::string& file : Words(files))
        {
            const std::string path = folder + file.substr(0, file.find_first_of("!?/"));
            if (file.ends_with('/'))
                CreateFolder(m_kFolder.Path(path));
            else if (file.ends_with('!'))
                Write(path, "x");
            else
                Write(path, BvhText(file.ends_with('?') ? kMaxBones : kPoserBones));
        }
    }
    std::string ResultsIn(const std::string& folder) const
    {
        std::set<std::string> files;
        for (const char* extension : {".htr", ".orn"})
        {
            for (const std::string& file : FilesInFolder(m_kFolder.Path(folder), extension))
                files.insert(file);
        }
        return Joined(files);
    }
    int Run(const std::string& folder, int job, const char* profile)
    {
        m_kWindow.m_kList.SetCurSel(-1);
        if (*profile)
            SelectProfile(profile);
        m_kWindow.m_kBoxes = {""};
        m_kWindow.m_kTitles = {"Gaitwright v2.0"};
        m_kWindow.folderAnswer = FolderChoice{m_kFolder.Path(folder), job};
        m_kWindow.TakeCalls();
        return m_kContent.RunBatch();
    }
};

TEST_F(BatchTest, Runs)
{
    const struct
    {
        const char* what;
        const char* files;
        const char* profile; // selected before the run
        const char* words;
        const char* count;   // start of the summary
        const char* results; // in the folder afterwards
        const char* title;   // at the end, after the product's name
        int job;
        int answer;
    } rows[] = {
        {"all good", "a.bvh b.BVH c.bvh", "Poser", "146", "3 ", "a.htr b.htr c.htr", "", 1, 1},
        {"no file of the kind", "a.htr", "Poser", "", "", "a.htr", "", 1, 0},
        {"one broken", "a.bvh b.bvh! c.bvh", "Poser", "missing-section HIERARCHY, 138, 146", "1 ", "a.htr",
         "", 1, 1},
        {"no profile selected", "a.bvh", "", "no-profile, 144", "", "", " - Batch Converting 1 : a", 1, 0},
        {"one cannot be written", "a.bvh b.bvh b.htr/", "Poser", "write-error, 146", "1 ", "a.htr", "", 1, 1},
        {"packages need no profile", "a.htr b.HTR!", "", "148", "2 ", "a.htr a.orn b.HTR b.orn", "", 2, 1},
    };
    for (const auto& row : rows)
    {
        SCOPED_TRACE(row.what);
        const std::string folder = std::string(row.what) + '/';
        WriteFiles(folder, row.files);
        EXPECT_EQ(Run(folder, row.job, row.profile), row.answer);
        EXPECT_EQ(m_kWindow.TakeWords(), row.words);
        EXPECT_EQ(m_kWindow.m_kBoxes.back().find(row.count), 0u) << m_kWindow.m_kBoxes.back();
        EXPECT_EQ(m_kWindow.m_kTitles.back(), std::string("Gaitwright v2.0") + row.title);
        EXPECT_EQ(ResultsIn(folder), row.results);
        EXPECT_EQ(m_kWindow.m_iWaits, 0);
    }
}

TEST_F(BatchTest, AMisfitAbandonsTheRunAndKeepsWhatIsDone)
{
    WriteFiles("run/", "a.bvh b.bvh? c.bvh");
    EXPECT_EQ(Run("run/", 1, "Poser"), 0);
    EXPECT_EQ(m_kWindow.TakeWords().find("misfit"), 0u);
    EXPECT_EQ(m_kWindow.m_kBoxes.back(), "Unable to convert motion with selected profile!");
    EXPECT_EQ(m_kWindow.m_kTitles.back(), "Gaitwright v2.0 - Batch Converting 2 : b");
    EXPECT_EQ(ResultsIn("run/"), "a.htr");
}

TEST_F(BatchTest, APackageThatCannotBeReadEndsTheRunWithoutAWord)
{
    Write("run/a.htr", "text");
    m_kWindow.onPaint = [this] { DeleteFile(m_kFolder.Path("run/a.htr")); };
    EXPECT_EQ(Run("run/", 2, ""), 0);
    EXPECT_EQ(m_kWindow.TakeWords().find("not-found"), 0u);
    EXPECT_EQ(m_kWindow.m_kBoxes.back(), "");
    EXPECT_EQ(m_kWindow.m_kTitles.back(), "Gaitwright v2.0 - Batch Converting 1 : a");
}

TEST_F(BatchTest, ReadsNoShift)
{
    Write("run/a.bvh", BvhText(kPoserBones));
    ASSERT_EQ(Run("run/", 1, "Poser"), 1);
    const std::string without = Read("run/a.htr");
    EXPECT_NE(without.find("NumFrames 3"), std::string::npos) << "where a save multiplies the frames";
    EXPECT_EQ(m_kPlatform.m_kSettings["MotionSource"], m_kFolder.Path("run/"));
    EXPECT_FALSE(m_kContent.IsConverted()) << "a run leaves the flags alone";
    m_kWindow.m_kKeys = {EKey::LeftShift};
    ASSERT_EQ(Run("run/", 1, "Poser"), 1);
    EXPECT_EQ(Read("run/a.htr"), without);
}

} // namespace gw
