// Files on disk after a save, and messages to the user.

#include "ContentFixture.h"

#include "CCustomData.h"
#include "COrrinStream.h"
#include "Paths.h"

#include <cstring>
#include <sys/stat.h>
#include <tuple>

namespace gw {
namespace {

// Returns the data block with a name in a package.
std::span<const std::byte> DataOf(COrrinStream& package, const char* name)
{
    CObject* const found = package.GetRoot(1)->FindObject(name, nullptr, false);
    const auto* data = RecordCast<CRawData>(found);
    return data ? data->Data() : std::span<const std::byte>();
}

std::string TextOf(std::span<const std::byte> bytes)
{
    return {reinterpret_cast<const char*>(bytes.data()), bytes.size()};
}

} // namespace

TEST_F(ContentTest, APackageHoldsTheMotionAtFourTimesItsFrames)
{
    OpenAndConvert();
    EXPECT_EQ(SaveAs("out.KINETRA"), 1);
    COrrinStream package;
    ASSERT_TRUE(package.LoadFile(m_kFolder.Path("out.KINETRA"), false));
    float rates[2];
    ASSERT_EQ(DataOf(package, "MotionInfo").size(), 16u);
    std::memcpy(rates, DataOf(package, "MotionInfo").data() + 8, sizeof rates);
    EXPECT_EQ(rates[0], 30.0f) << "the profile's rate";
    EXPECT_EQ(rates[1], 60.0f);
    EXPECT_NE(TextOf(DataOf(package, "MotionFile")).find("NumFrames 12"), std::string::npos);
}

TEST_F(ContentTest, FilesAfterASave)
{
    // kept: in the folder afterwards
    const std::tuple<const char*, const char*, std::vector<std::string>> rows[] = {
        {"a package leaves no HTR", "a.Kinetra", {"a.Kinetra"}},
        {"any other extension gives an HTR", "b.mot", {"b.htr"}},
        {"an HTR", "c.htr", {"c.htr"}},
        {"no extension", "d", {"d.htr"}},
    };
    OpenAndConvert();
    for (const auto& [what, name, kept] : rows)
    {
        SCOPED_TRACE(what);
        const std::string folder = std::string("saved-") + name + '/';
        CreateFolder(m_kFolder.Path(folder));
        SaveAs(folder + name);
        std::vector<std::string> files;
        for (const char* extension : {".Kinetra", ".htr", ".mot", ".tmp", ""})
        {
            for (const std::string& file : FilesInFolder(m_kFolder.Path(folder), extension))
                files.push_back(file);
        }
        EXPECT_EQ(files, kept);
        EXPECT_EQ(m_kWindow.TakeCalls().back(), "show " + m_kFolder.Path(folder + name));
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
        EXPECT_EQ(m_kWindow.m_kBoxes.back(), "Nothing was written.\n" + m_kFolder.Path(name) +
                                                 ": the file cannot be written (check free space and "
                                                 "permissions)\n\nShow the file in its folder?");
        Do(next);
        EXPECT_EQ(m_kWindow.m_kTitles.back(), "Gaitwright v2.0");
        m_kWindow.TakeCalls();
    }
    EXPECT_EQ(Read("old.Kinetra"), "old");
    EXPECT_TRUE(FilesInFolder(m_kFolder.Path(), ".htr").empty()) << "no intermediate file is left";
    SaveAs("good.Kinetra");
    EXPECT_EQ(m_kWindow.m_kBoxes.back(), "Show the file in its folder?");
}

TEST_F(ContentTest, AProfileWithoutAFrameRateWritesNothing)
{
    OpenAndConvert();
    for (const char* rate : {"0", "-30", "x"})
    {
        SCOPED_TRACE(rate);
        m_kContent.UseProfileFile(
            Write("odd.prf", std::string("Odd\nFrameRate ") + rate + "\nhip <---> LowerTorso 0\n"));
        EXPECT_FALSE(m_kContent.WriteResult(m_kFolder.Path("odd.Kinetra")));
        EXPECT_FALSE(Exists("odd.Kinetra"));
    }
}

TEST_F(ContentTest, TheFileIsShownOnlyWhenAskedFor)
{
    OpenAndConvert();
    m_kWindow.m_kAnswers[171] = EAnswer::Cancel;
    SaveAs("out.Kinetra");
    EXPECT_EQ(m_kWindow.TakeCalls(), (std::vector<std::string>{"save *.Kinetra", "box 171"}));
}

} // namespace gw
