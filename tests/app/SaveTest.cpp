// Files on disk after a save, and messages to the user.

#include "ContentFixture.h"

#include "Paths.h"

#include <filesystem>
#include <gmock/gmock.h>
#include <sys/stat.h>
#include <tuple>

namespace gw {

TEST_F(ContentTest, APackageHoldsTheMotionAtFourTimesItsFrames)
{
    OpenAndConvert();
    EXPECT_EQ(SaveAs("out.KINETRA"), 1);
    const std::string package = Read("out.KINETRA");
    const float rates[] = {30.0f, 60.0f}; // the profile's, and a fixed one
    EXPECT_EQ(package.substr(298, 8), std::string(reinterpret_cast<const char*>(rates), 8));
    EXPECT_NE(package.find("NumFrames 12"), std::string::npos);
}

TEST_F(ContentTest, FilesAfterASave)
{
    const std::tuple<const char*, const char*, const char*> rows[] = {
        {"a package leaves no HTR", "a.Kinetra", "a.Kinetra"},
        {"any other extension gives an HTR", "b.mot", "b.htr"},
        {"no extension", "d", "d.htr"},
    };
    OpenAndConvert();
    for (const auto& [what, name, kept] : rows)
    {
        SCOPED_TRACE(what);
        const CTempFolder folder;
        m_kWindow.saveAnswer = folder.Path(name);
        m_kContent.SaveResult();
        std::string files;
        for (const auto& entry : std::filesystem::directory_iterator(folder.Path()))
            files += entry.path().filename().string();
        EXPECT_EQ(files, kept);
        EXPECT_EQ(m_kWindow.TakeCalls().back(), "show " + folder.Path(name));
        EXPECT_TRUE(m_kContent.IsSaved());
    }
}

TEST_F(ContentTest, AnHtrBesideThePackageStaysAsItWas)
{
    OpenAndConvert();
    Write("out.htr", "somebody's own");
    SaveAs("out.Kinetra");
    EXPECT_EQ(Read("out.htr"), "somebody's own");
    EXPECT_TRUE(Exists("out.Kinetra"));
}

TEST_F(ContentTest, AFailedSaveLeavesTheOldFileAndSaysSoInTheTitle)
{
    using testing::AllOf, testing::EndsWith, testing::StartsWith;
    OpenAndConvert();
    const std::string path = Write("old.Kinetra", "old");
    chmod(path.c_str(), 0444);
    // next: a step that clears the title's report
    const std::tuple<const char*, const char*, const char*> rows[] = {
        {"a read-only package", "old.Kinetra", "click convert"},
        {"a folder that is not there", "none/out.Kinetra", "open gone.bvh"},
        {"an HTR in such a folder", "none/out.htr", "open walk.bvh"},
    };
    for (const auto& [what, name, next] : rows)
    {
        SCOPED_TRACE(what);
        EXPECT_EQ(SaveAs(name), 1);
        EXPECT_TRUE(m_kContent.IsSaved()) << "the flag goes as if it had been written";
        EXPECT_EQ(m_kWindow.TakeWords().find("write-error"), 0u);
        EXPECT_EQ(m_kWindow.m_kTitles.back().find("Gaitwright v2.0 - not saved: "), 0u)
            << m_kWindow.m_kTitles.back();
        EXPECT_THAT(m_kWindow.m_kBoxes.back(),
                    AllOf(StartsWith("Nothing was written.\n" + m_kFolder.Path(name) +
                                     ": the file cannot be written: "),
                          EndsWith("\n\nShow the file in its folder?")));
        Do(next);
        EXPECT_EQ(m_kWindow.m_kTitles.back(), "Gaitwright v2.0");
        m_kWindow.TakeCalls();
    }
    EXPECT_EQ(Read("old.Kinetra"), "old");
    EXPECT_TRUE(FilesInFolder(m_kFolder.Path(), ".htr").empty()) << "no intermediate file is left";
    SaveAs("good.Kinetra");
    EXPECT_EQ(m_kWindow.m_kBoxes.back(), "Show the file in its folder?");
}

TEST_F(ContentTest, TheFileIsShownOnlyWhenAskedFor)
{
    OpenAndConvert();
    m_kWindow.m_kAnswers[171] = EAnswer::Cancel;
    SaveAs("out.Kinetra");
    EXPECT_EQ(m_kWindow.TakeCalls(), (std::vector<std::string>{"save *.Kinetra", "box 171"}));
}

} // namespace gw
