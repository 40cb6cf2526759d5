#include "CMappedFile.h"
#include "CPrivateFile.h"
#include "CSafeFile.h"
#include "Paths.h"
#include "PrivateNames.h"
#include "TempFolder.h"

#include <algorithm>
#include <fcntl.h>
#include <filesystem>
#include <gtest/gtest.h>
#include <numeric>
#include <sys/mman.h>
#include <sys/stat.h>
#include <sys/wait.h>
#include <tuple>

namespace gw {
namespace {

namespace fs = std::filesystem;

struct stat StatusOf(const std::string& path)
{
    struct stat status = {};
    EXPECT_EQ(stat(path.c_str(), &status), 0) << path;
    return status;
}

unsigned ModeOf(const std::string& path)
{
    return StatusOf(path).st_mode & 07777;
}

bool Save(const std::string& path, std::string_view text)
{
    CSafeFile file;
    return file.Open(path) && file.Write(text) && file.Commit();
}

size_t EntryCount(const CTempFolder& folder)
{
    return static_cast<size_t>(
        std::distance(fs::directory_iterator(folder.Path()), fs::directory_iterator()));
}

} // namespace

TEST(Paths, SplitIntoFolderStemAndExtension)
{
    const std::tuple<const char*, const char*, const char*, const char*> rows[] = {
        {"/a.b/walk.cut.bvh", "/a.b/", "walk.cut", ".bvh"},
        {"C:\\in\\walk.BVH", "C:\\in\\", "walk", ".BVH"},
        {"a/b\\walk", "a/b\\", "walk", ""},
        {"walk.", "", "walk", "."},
        {".bvh", "", "", ".bvh"},
        {"a.b/", "a.b/", "", ""},
        {"", "", "", ""},
    };
    for (const auto& [path, folder, stem, extension] : rows)
    {
        SCOPED_TRACE(path);
        const PathParts parts = SplitPath(path);
        EXPECT_EQ(parts.folder, folder);
        EXPECT_EQ(parts.stem, stem);
        EXPECT_EQ(parts.extension, extension);
    }
    EXPECT_TRUE(HasExtension("x.y/walk.BVH", ".bvh"));
    EXPECT_EQ(WithSeparator(""), "");
    EXPECT_EQ(WithSeparator("a\\"), "a\\");
}

TEST(Paths, FilesOfAFolderComeInNameOrder)
{
    const CTempFolder folder;
    for (const char* name : {"c.prf", "a.PRF", "b.prf", "b.prf.bak", "prf", "Z.prf"})
        WriteBytes(folder.Path(name), "");
    CreateFolder(folder.Path("folder.prf"));
    fs::create_symlink("nowhere", folder.Path("dangling.prf"));
    EXPECT_EQ(FilesInFolder(folder.Path(), ".prf"),
              (std::vector<std::string>{"Z.prf", "a.PRF", "b.prf", "c.prf"}));
    EXPECT_TRUE(FilesInFolder(folder.Path("none"), ".prf").empty());
}

TEST(CMappedFile, MapsRegularFilesOnly)
{
    const CTempFolder folder;
    WriteBytes(folder.Path("full"), "HIERARCHY");
    WriteBytes(folder.Path("empty"), "");
    ASSERT_EQ(mkfifo(folder.Path("pipe").c_str(), 0600), 0);
    const std::tuple<const char*, std::string, EFailure, const char*> rows[] = {
        {"file", folder.Path("full"), EFailure::None, "HIERARCHY"},
        {"empty file", folder.Path("empty"), EFailure::None, ""},
        {"nothing there", folder.Path("none"), EFailure::NotFound, ""},
        {"folder", folder.Path(), EFailure::NotRegular, ""},
        {"device", "/dev/zero", EFailure::NotRegular, ""},
        {"pipe, not waited", folder.Path("pipe"), EFailure::NotRegular, ""},
    };
    for (const auto& [what, path, failure, text] : rows)
    {
        SCOPED_TRACE(what);
        CMappedFile file;
        ASSERT_EQ(file.Open(folder.Path("full")), EFailure::None); // replaced in every case
        EXPECT_EQ(file.Open(path), failure);
        EXPECT_EQ(file.Text(), text);
        EXPECT_EQ(file.Bytes().size(), file.Text().size());
    }
}

TEST(CMappedFile, KeepsItsBytesWhenMovedAndAfterForgetting)
{
    for (const size_t size : {size_t{5000}, (size_t{1} << 20) + 1})
    {
        SCOPED_TRACE(size);
        const CTempFolder folder;
        std::string text(size, 'x');
        std::iota(text.begin(), text.end(), '\0');
        WriteBytes(folder.Path("a"), text);
        CMappedFile first;
        ASSERT_EQ(first.Open(folder.Path("a")), EFailure::None);
        CMappedFile second(std::move(first));
        CMappedFile third;
        third = std::move(second);
        for (const size_t offset : {size_t{0}, size_t{4500}, text.size(), text.size() + 1, SIZE_MAX})
        {
            third.Forget(offset);
            EXPECT_EQ(third.Text(), text) << offset;
        }
        third.Close();
        third.Forget(100);
        EXPECT_TRUE(third.Text().empty());
    }
}

// A mapping that loses its pages yields zeros and reports it; the program continues.
TEST(CMappedFile, AFileThatIsCutWhileItIsReadIsNotWhole)
{
    constexpr size_t size = (size_t{1} << 21) + 1000;
    for (const size_t left : {size_t{0}, size_t{1} << 20, (size_t{1} << 20) + 100, size - 1, size})
    {
        SCOPED_TRACE(left);
        const CTempFolder folder;
        WriteBytes(folder.Path("a"), std::string(size, 'x'));
        CMappedFile other, file;
        ASSERT_EQ(other.Open(folder.Path("a")), EFailure::None);
        other.Close();
        ASSERT_EQ(file.Open(folder.Path("a")), EFailure::None);
        EXPECT_TRUE(file.IsWhole());
        fs::resize_file(folder.Path("a"), left);
        for (int round = 0; round < 2; ++round)
        {
            EXPECT_EQ(std::ranges::count(file.Text(), 'x'), static_cast<ptrdiff_t>(left));
            EXPECT_EQ(file.IsWhole(), left == size);
            file.Forget(size / 2);
        }
        CMappedFile moved(std::move(file));
        EXPECT_EQ(moved.IsWhole(), left == size);
        moved.Close();
        EXPECT_TRUE(moved.IsWhole());
    }
}

TEST(CMappedFile, AnotherBusErrorStillEndsTheProgram)
{
    const CTempFolder folder;
    WriteBytes(folder.Path("a"), std::string(size_t{1} << 21, 'x'));
    CMappedFile file;
    ASSERT_EQ(file.Open(folder.Path("a")), EFailure::None);
    const int foreign = open(folder.Path("a").c_str(), O_RDONLY);
    const auto* bytes =
        static_cast<const volatile char*>(mmap(nullptr, 4096, PROT_READ, MAP_SHARED, foreign, 0));
    fs::resize_file(folder.Path("a"), 0);
    EXPECT_DEATH((void)bytes[0], "");
    close(foreign);
}

TEST(CSafeFile, ReplacesInOneStepAndKeepsGroupAndPermissions)
{
    const CTempFolder folder;
    const std::string path = folder.Path("a.htr");
    WriteBytes(path, "old");
    // only works for root
    [[maybe_unused]] const int foreign = chown(path.c_str(), static_cast<uid_t>(-1), 4321);
    const gid_t group = StatusOf(path).st_gid;
    fs::permissions(path, fs::perms(06660)); // the umask would remove these
    CSafeFile file;
    const mode_t mask = umask(022);
    ASSERT_TRUE(file.Open(path));
    umask(mask);
    EXPECT_EQ(ModeOf(file.PrivatePath()), 0600u); // not readable by others in the meantime
    EXPECT_TRUE(file.Write("new "));
    const std::byte bytes[] = {std::byte{'0'}, std::byte{0}};
    EXPECT_TRUE(file.Write(bytes));
    EXPECT_EQ(ReadBytes(path), "old");
    EXPECT_EQ(ReadBytes(file.PrivatePath()), std::string("new 0\0", 6));
    EXPECT_TRUE(file.Commit());
    EXPECT_FALSE(file.Commit());
    EXPECT_EQ(ReadBytes(path), std::string("new 0\0", 6));
    EXPECT_EQ(ModeOf(path), 0660u) << "without set-id bits";
    EXPECT_EQ(StatusOf(path).st_gid, group);
    EXPECT_EQ(EntryCount(folder), 1u);
}

TEST(CSafeFile, NewFilesHaveTheUsersModeAndAnyName)
{
    const CTempFolder folder;
    const std::string longest = folder.Path(std::string(251, 'n') + ".htr");
    const mode_t mask = umask(027);
    EXPECT_TRUE(Save(longest, "text"));
    umask(mask);
    EXPECT_EQ(ModeOf(longest), 0640u);
    EXPECT_TRUE(Save(folder.Path("back\\slash"), ""));
    EXPECT_EQ(ReadBytes(folder.Path("back\\slash")), "");
    EXPECT_EQ(EntryCount(folder), 2u);
}

TEST(CSafeFile, WithoutACommitTheOldFileStays)
{
    const CTempFolder folder;
    const std::string path = folder.Path("a.htr");
    WriteBytes(path, "old");
    {
        CSafeFile file;
        ASSERT_TRUE(file.Open(path));
        EXPECT_TRUE(file.Write("new"));
        ASSERT_TRUE(file.Open(path)); // starts again
        EXPECT_TRUE(file.Write("newer"));
    }
    EXPECT_EQ(ReadBytes(path), "old");
    EXPECT_EQ(EntryCount(folder), 1u);
}

TEST(CSafeFile, SymbolicLinksAreFollowed)
{
    const CTempFolder folder;
    CreateFolder(folder.Path("real"));
    WriteBytes(folder.Path("real/a"), "old");
    fs::create_symlink("real/a", folder.Path("one"));
    fs::create_symlink(folder.Path("one"), folder.Path("two"));
    fs::create_symlink("real/b", folder.Path("dangling"));
    EXPECT_TRUE(Save(folder.Path("two"), "new"));
    EXPECT_EQ(ReadBytes(folder.Path("real/a")), "new");
    EXPECT_TRUE(Save(folder.Path("dangling"), "made"));
    EXPECT_EQ(ReadBytes(folder.Path("real/b")), "made");
    for (const char* link : {"one", "two", "dangling"})
        EXPECT_TRUE(fs::is_symlink(folder.Path(link))) << link;
}

TEST(CSafeFile, WhatMayNotBeReplacedIsRefused)
{
    const CTempFolder folder;
    WriteBytes(folder.Path("readonly"), "old");
    fs::permissions(folder.Path("readonly"), fs::perms::owner_read);
    fs::create_symlink("readonly", folder.Path("link"));
    fs::create_symlink("ring", folder.Path("ring"));
    fs::create_directory(folder.Path("folder"));
    const size_t before = EntryCount(folder);
    const std::tuple<const char*, std::string> rows[] = {
        {"read-only file", folder.Path("readonly")}, {"link to it", folder.Path("link")},
        {"folder", folder.Path("folder")},           {"device", "/dev/null"},
        {"links in a ring", folder.Path("ring")},    {"no name", ""},
    };
    for (const auto& [what, path] : rows)
    {
        SCOPED_TRACE(what);
        CSafeFile file;
        EXPECT_FALSE(file.Open(path));
        EXPECT_FALSE(file.Write("new"));
        EXPECT_FALSE(file.Commit());
    }
    EXPECT_EQ(ReadBytes(folder.Path("readonly")), "old");
    EXPECT_EQ(EntryCount(folder), before);
}

TEST(CSafeFile, PrivateFilesLieBesideAndDiffer)
{
    const CTempFolder folder;
    {
        CPrivateFile first(folder.Path("walk.htr"), ".htr");
        CPrivateFile second(folder.Path("walk.htr"), ".htr");
        EXPECT_NE(first.Path(), second.Path());
        for (CPrivateFile* file : {&first, &second})
        {
            const std::string& path = file->Path();
            EXPECT_EQ(SplitPath(path).folder, folder.Path());
            EXPECT_TRUE(HasExtension(path, ".htr"));
            EXPECT_EQ(ReadBytes(path), "");
            EXPECT_EQ(ModeOf(path), 0600u) << "for nobody else's eyes";
            EXPECT_TRUE(file->Write("long text") && file->Write("text"));
            EXPECT_EQ(ReadBytes(path), "text");
        }
        EXPECT_TRUE(FilesInFolder(folder.Path(), ".htr").empty()) << "nobody takes one for a motion";
        EXPECT_EQ(CPrivateFile(folder.Path("none/walk.htr"), ".htr").Path(), "");
    }
    EXPECT_EQ(EntryCount(folder), 0u);
}

// Even if the name says that its program is running, or ran elsewhere: only the lock counts.
TEST(PrivateNames, ASaveRemovesWhatNoLivingProgramHolds)
{
    const CTempFolder folder;
    CPrivateFile live(folder.Path("walk.htr"), ".htr");
    std::string foreign = PrivateName(folder.Path(), ".tmp");
    foreign.replace(foreign.size() - 30, 8, "12345678");
    const std::string dead[] = {PrivateName(folder.Path(), ".tmp"), foreign};
    const std::string kept[] = {live.Path(), folder.Path(".gaitwright-notes"), folder.Path("a.tmp")};
    for (const std::string& path : dead)
        WriteBytes(path, "x");
    for (const std::string& path : kept)
        WriteBytes(path, "x");
    const std::string link = PrivateName(folder.Path(), ".tmp");
    fs::create_symlink("a.tmp", link);
    RemoveLeftovers(folder.Path());
    for (const std::string& path : dead)
        EXPECT_FALSE(FileExists(path)) << path;
    for (const std::string& path : kept)
        EXPECT_TRUE(FileExists(path)) << path;
    EXPECT_TRUE(IsLink(link));

    CreateFolder(folder.Path("other"));
    const std::string left = PrivateName(folder.Path("other/"), ".tmp");
    WriteBytes(left, "x");
    EXPECT_TRUE(Save(folder.Path("other/walk.htr"), "new"));
    EXPECT_FALSE(FileExists(left));
}

// Programs that create, sweep and rename in one folder at the same time, as shards do.
TEST(PrivateNames, SweepersTakeNothingFromThoseWhoWrite)
{
    const CTempFolder folder;
    std::vector<pid_t> programs;
    for (int program = 0; program < 8; ++program)
    {
        programs.push_back(fork());
        if (programs.back() != 0)
            continue;
        bool good = true;
        for (int i = 0; i < 200 && good; ++i)
        {
            CSafeFile file;
            good = file.Open(folder.Path(std::to_string(program))) && file.Write("x");
            RemoveLeftovers(folder.Path());
            good = good && file.Commit();
        }
        _exit(good ? 0 : 1);
    }
    for (const pid_t program : programs)
    {
        int status = 0;
        waitpid(program, &status, 0);
        EXPECT_EQ(status, 0);
    }
    EXPECT_EQ(EntryCount(folder), programs.size());
}

TEST(CSafeFile, AGateHoldsBackWhatWouldTakeItsName)
{
    const CTempFolder folder;
    CPrivateFile intermediate(folder.Path("walk.Kinetra"), ".htr");
    int asked = 0;
    CSafeFile::SetCommitGate([&](const std::string&) { return ++asked > 1; });
    EXPECT_TRUE(intermediate.Write("new"));
    EXPECT_EQ(asked, 0);
    EXPECT_FALSE(Save(folder.Path("walk.Kinetra"), "new"));
    EXPECT_EQ(EntryCount(folder), 1u);
    EXPECT_TRUE(Save(folder.Path("walk.Kinetra"), "new"));
    CSafeFile::SetCommitGate({});
    EXPECT_EQ(EntryCount(folder), 2u);
}

} // namespace gw
