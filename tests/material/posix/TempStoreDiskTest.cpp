#include "CTempPagedFile.h"
#include "CTempStore.h"
#include "Paths.h"
#include "TempFolder.h"

#include <filesystem>
#include <gtest/gtest.h>

#include <csignal>

#include <sys/resource.h>
#include <sys/stat.h>

namespace gw {
namespace {

constexpr uint64_t kFile = CTempPagedFile::kFileBytes;
constexpr uint64_t kPage = CTempPagedFile::kPageBytes;

class TempStoreDisk : public testing::Test
{
protected:
    CTempFolder m_kFolder;
    CTempStore m_kStore{m_kFolder.Path("TKTmp/")};
};

// Limits the size of files in this process, like a full disk.
class CFullDisk
{
public:
    explicit CFullDisk(rlim_t byteCount) : m_pkHandler(std::signal(SIGXFSZ, SIG_IGN))
    {
        getrlimit(RLIMIT_FSIZE, &m_kLimit);
        const rlimit full{byteCount, m_kLimit.rlim_max};
        setrlimit(RLIMIT_FSIZE, &full);
    }
    ~CFullDisk()
    {
        setrlimit(RLIMIT_FSIZE, &m_kLimit);
        std::signal(SIGXFSZ, m_pkHandler);
    }

private:
    rlimit m_kLimit{};
    void (*m_pkHandler)(int);
};

} // namespace

// Touching unreserved space would raise a signal.
TEST_F(TempStoreDisk, SpaceIsReservedBeforeItIsTouched)
{
    m_kStore.Allocate(10 * kPage);
    const std::string name = FilesInFolder(m_kStore.GetFolder(), ".tmp").at(0);
    struct stat status = {};
    ASSERT_EQ(stat((m_kStore.GetFolder() + name).c_str(), &status), 0);
    constexpr int64_t kSector = 512;
    EXPECT_GE(status.st_blocks * kSector, int64_t{10 * kPage});
    EXPECT_LT(status.st_blocks * kSector, int64_t{kFile / 2}) << "a small block does not cost a whole file";
}

TEST_F(TempStoreDisk, AFullDiskIsAnAnswer)
{
    const uint32_t before = m_kStore.Allocate(kPage);
    {
        const CFullDisk full(kFile / 2);
        EXPECT_EQ(m_kStore.Allocate(kFile + 1), 0u);
        EXPECT_EQ(m_kStore.GetTotal(), kFile);
        EXPECT_EQ(FilesInFolder(m_kStore.GetFolder(), ".tmp").size(), 1u);
        EXPECT_NE(m_kStore.Allocate(kPage), 0u) << "what there is room for";
    }
    EXPECT_NE(m_kStore.Map(before), nullptr);
}

// Anybody can create a link in the folder for temporary files.
TEST_F(TempStoreDisk, ALinkToAFolderOfSomebodyIsLeftAlone)
{
    CreateFolder(m_kFolder.Path("home"));
    WriteBytes(m_kFolder.Path("home/mine.tmp"), "x");
    std::filesystem::create_symlink(m_kFolder.Path("home"), m_kFolder.Path("TKTmp"));
    CTempStore store(m_kFolder.Path("TKTmp/"));
    EXPECT_EQ(store.Allocate(1), 0u);
    CTempStore::Purge(m_kFolder.Path("TKTmp"));
    EXPECT_TRUE(FileExists(m_kFolder.Path("home/mine.tmp")));
}

} // namespace gw
