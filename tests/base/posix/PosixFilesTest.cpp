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

} // namespace

TEST(CMappedFile, APipeIsNeitherReadNorReplaced)
{
    const CTempFolder folder;
    ASSERT_EQ(mkfifo(folder.Path("pipe").c_str(), 0600), 0);
    EXPECT_EQ(CMappedFile().Open(folder.Path("pipe")), EFailure::NotRegular);
    EXPECT_FALSE(Save(folder.Path("pipe"), ""));
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

TEST(CSafeFile, AReplacedFileKeepsGroupAndPermissions)
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
    EXPECT_TRUE(file.Commit());
    EXPECT_EQ(ModeOf(path), 0660u) << "without set-id bits";
    EXPECT_EQ(StatusOf(path).st_gid, group);
    EXPECT_EQ(ModeOf(CPrivateFile(path, ".tmp").Path()), 0600u);
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
    EXPECT_EQ(FilesInFolder(folder.Path(), "").size(), 1u) << "the one without an extension";
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

// Like the shards of a run, these programs create, sweep and rename files in one folder at the same time.
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
    EXPECT_EQ(FilesInFolder(folder.Path(), "").size(), programs.size());
}

} // namespace gw
