#include "CTempPagedFile.h"
#include "CTempStore.h"
#include "Paths.h"
#include "TempFolder.h"

#include <gtest/gtest.h>

#include <cstring>

namespace gw {
namespace {

constexpr uint64_t kFile = CTempPagedFile::kFileBytes;
constexpr uint64_t kPage = CTempPagedFile::kPageBytes;

class TempStore : public testing::Test
{
protected:
    size_t FileCount() const { return FilesInFolder(m_kStore.GetFolder(), ".tmp").size(); }

    CTempFolder m_kFolder;
    CTempStore m_kStore{m_kFolder.Path("TKTmp/")};
};

} // namespace

TEST_F(TempStore, SizesDecideBetweenPagesAndAFileOfTheirOwn)
{
    EXPECT_FALSE(FolderExists(m_kStore.GetFolder()));
    EXPECT_EQ(m_kStore.Allocate(1), 0x00010001u);
    EXPECT_EQ(m_kStore.Allocate(kFile), 0x00020001u) << "takes all pages of a fresh file";
    EXPECT_EQ(m_kStore.Allocate(kFile + 1), 0x00030001u) << "one byte more has its own";
    EXPECT_EQ(m_kStore.GetTotal(), 3 * kFile + 1);
    EXPECT_EQ(m_kStore.Allocate(kPage), 0x00010002u) << "the next page of the first file";
    EXPECT_EQ(m_kStore.Allocate(kPage + 1), 0x00010003u);
    EXPECT_EQ(m_kStore.Allocate(0), 0x00010005u) << "even nothing takes a page";
    EXPECT_EQ(FileCount(), 3u);
    uint64_t size = 0;
    EXPECT_TRUE(FileSize(m_kStore.GetFolder() + FilesInFolder(m_kStore.GetFolder(), ".tmp")[0], size));
    EXPECT_GE(size, kFile);
    EXPECT_TRUE(FilesInFolder(m_kStore.GetFolder(), ".tmp")[0].starts_with("TK_"));
}

TEST_F(TempStore, TheFirstGapThatFitsIsTaken)
{
    uint32_t blocks[5];
    for (uint32_t& block : blocks)
        block = m_kStore.Allocate(2 * kPage);
    m_kStore.Free(blocks[1]);
    m_kStore.Free(blocks[3]);
    EXPECT_EQ(m_kStore.Allocate(3 * kPage), 0x0001000bu) << "no gap is large enough";
    EXPECT_EQ(m_kStore.Allocate(kPage), blocks[1]);
    EXPECT_EQ(m_kStore.Allocate(2 * kPage), blocks[3]);
    m_kStore.Free(blocks[2]);
    EXPECT_EQ(m_kStore.Allocate(3 * kPage), blocks[1] + 1) << "neighbours that are free make one gap";
}

TEST_F(TempStore, ABlockKeepsItsBytesWhileNobodyLooks)
{
    const uint32_t small = m_kStore.Allocate(3 * kPage);
    const uint32_t other = m_kStore.Allocate(kPage);
    const uint32_t large = m_kStore.Allocate(kFile + 5);
    for (const auto& [handle, size] : {std::pair{small, 3 * kPage}, {other, kPage}, {large, kFile + 5}})
    {
        std::byte* const bytes = m_kStore.Map(handle);
        ASSERT_NE(bytes, nullptr);
        EXPECT_EQ(m_kStore.Map(handle), bytes) << "a second use sees the same view";
        std::memset(bytes, static_cast<int>(handle >> 16 ^ handle), size);
        m_kStore.Unmap(handle);
        bytes[size - 1] = std::byte{77}; // the first mapping is still valid
        m_kStore.Unmap(handle);
    }
    for (const auto& [handle, size] : {std::pair{small, 3 * kPage}, {other, kPage}, {large, kFile + 5}})
    {
        std::byte* const bytes = m_kStore.Map(handle);
        EXPECT_EQ(bytes[0], static_cast<std::byte>(handle >> 16 ^ handle));
        EXPECT_EQ(bytes[size - 1], std::byte{77});
        m_kStore.Unmap(handle);
    }
}

TEST_F(TempStore, UnknownHandlesDoNothing)
{
    const uint32_t handle = m_kStore.Allocate(2 * kPage);
    for (const uint32_t unknown : {0u, 1u, 65536u, handle + 1, handle + 0x10000, 0xffffffffu})
    {
        EXPECT_EQ(m_kStore.Map(unknown), nullptr) << unknown;
        m_kStore.Unmap(unknown);
        m_kStore.Free(unknown);
    }
    EXPECT_NE(m_kStore.Map(handle), nullptr);
}

TEST_F(TempStore, TheLastBlockTakesFileAndFolderAlong)
{
    const uint32_t first = m_kStore.Allocate(1);
    const uint32_t second = m_kStore.Allocate(kFile + 1);
    const uint32_t third = m_kStore.Allocate(kFile);
    m_kStore.Free(second);
    EXPECT_EQ(FileCount(), 2u);
    EXPECT_EQ(m_kStore.GetTotal(), 2 * kFile);
    EXPECT_EQ(m_kStore.Allocate(kFile), second) << "a null slot is used first";
    m_kStore.Free(second);
    m_kStore.Free(third);
    EXPECT_TRUE(FolderExists(m_kStore.GetFolder()));
    m_kStore.Free(first);
    EXPECT_EQ(m_kStore.GetTotal(), 0u);
    EXPECT_FALSE(FolderExists(m_kStore.GetFolder()));
    EXPECT_EQ(m_kStore.Allocate(1), first) << "and the folder comes back";
}

TEST_F(TempStore, TheLimitCountsWholeFiles)
{
    m_kStore.SetLimit(kFile + 100);
    EXPECT_EQ(m_kStore.Allocate(kFile + 101), 0u);
    EXPECT_EQ(m_kStore.Allocate(UINT64_MAX), 0u);
    EXPECT_NE(m_kStore.Allocate(kFile - kPage), 0u);
    EXPECT_EQ(m_kStore.Allocate(101 + kPage), 0u) << "a new file would be too much";
    EXPECT_NE(m_kStore.Allocate(kPage), 0u) << "a page of the file that is there is not";
    m_kStore.SetLimit(0);
    EXPECT_NE(m_kStore.Allocate(kPage), 0u);
    WriteBytes(m_kFolder.Path("file"), "x");
    CTempStore nowhere(m_kFolder.Path("file/TKTmp/"));
    EXPECT_EQ(nowhere.Allocate(1), 0u);
}

TEST_F(TempStore, WhatACrashLeftIsTakenAwayAndNobodyAliveHarmed)
{
    const std::string folder = m_kStore.GetFolder();
    const uint32_t handle = m_kStore.Allocate(1);
    WriteBytes(folder + "TK_old.tmp", "x");
    CTempStore other(folder);
    const uint32_t theirs = other.Allocate(1);
    EXPECT_FALSE(FileExists(folder + "TK_old.tmp")) << "by the first file";
    other.Free(theirs);
    std::byte* const bytes = m_kStore.Map(handle);
    ASSERT_NE(bytes, nullptr);
    bytes[kPage - 1] = std::byte{1};

    m_kStore.Unmap(handle);
    m_kStore.Free(handle);
    CreateFolder(folder);
    WriteBytes(folder + "TK_1.tmp", "x");
    WriteBytes(folder + "keep.txt", "x");
    CTempStore::Purge(folder);
    EXPECT_FALSE(FileExists(folder + "TK_1.tmp"));
    EXPECT_TRUE(FileExists(folder + "keep.txt"));
    DeleteFile(folder + "keep.txt");
    CTempStore::Purge(folder);
    EXPECT_FALSE(FolderExists(folder));
}

} // namespace gw
