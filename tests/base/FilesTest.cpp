#include "CMappedFile.h"
#include "CPrivateFile.h"
#include "CSafeFile.h"
#include "NativePath.h"
#include "Paths.h"
#include "PrivateNames.h"
#include "TempFolder.h"

#include <algorithm>
#include <filesystem>
#include <gtest/gtest.h>
#include <numeric>
#include <tuple>

namespace gw {
namespace {

namespace fs = std::filesystem;

constexpr const char* kDevice = kPathSeparator == '/' ? "/dev/zero" : "NUL";

bool Save(const std::string& path, std::string_view text)
{
    CSafeFile file;
    return file.Open(path) && file.Write(text) && file.Commit();
}

size_t EntryCount(const CTempFolder& folder)
{
    return static_cast<size_t>(
        std::distance(fs::directory_iterator(NativePath(folder.Path())), fs::directory_iterator()));
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
    MakeLink("nowhere", folder.Path("dangling.prf"));
    EXPECT_EQ(FilesInFolder(folder.Path(), ".prf"),
              (std::vector<std::string>{"Z.prf", "a.PRF", "b.prf", "c.prf"}));
    EXPECT_TRUE(FilesInFolder(folder.Path("none"), ".prf").empty());
}

TEST(CMappedFile, MapsRegularFilesOnly)
{
    const CTempFolder folder;
    WriteBytes(folder.Path("full"), "HIERARCHY");
    WriteBytes(folder.Path("empty"), "");
    const std::tuple<const char*, std::string, EFailure, const char*> rows[] = {
        {"file", folder.Path("full"), EFailure::None, "HIERARCHY"},
        {"empty file", folder.Path("empty"), EFailure::None, ""},
        {"nothing there", folder.Path("none"), EFailure::NotFound, ""},
        {"folder", folder.Path(), EFailure::NotRegular, ""},
        {"device", kDevice, EFailure::NotRegular, ""},
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

TEST(CSafeFile, ReplacesInOneStep)
{
    const CTempFolder folder;
    const std::string path = folder.Path("a.htr");
    WriteBytes(path, "old");
    const int reader = OpenFile(path, EOpen::Read);
    CSafeFile file;
    ASSERT_TRUE(file.Open(path));
    EXPECT_TRUE(file.Write("new "));
    const std::byte bytes[] = {std::byte{'1'}, std::byte{0}};
    EXPECT_TRUE(file.Write(bytes));
    EXPECT_TRUE(file.Rewrite(4, std::span(bytes + 1, 1)) && file.Write("."));
    EXPECT_TRUE(file.Rewrite(4, std::as_bytes(std::span("0", 1))));
    EXPECT_EQ(ReadBytes(path), "old");
    EXPECT_EQ(ReadBytes(file.PrivatePath()), std::string("new 0\0.", 7));
    EXPECT_TRUE(file.Commit()) << "although the old one is being read";
    EXPECT_FALSE(file.Commit());
    EXPECT_EQ(ReadBytes(path), std::string("new 0\0.", 7));
    char old[4] = {};
    EXPECT_EQ(ReadSome(reader, old, 3), 3);
    EXPECT_STREQ(old, "old");
    CloseFile(reader);
    EXPECT_EQ(EntryCount(folder), 1u);
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

TEST(CSafeFile, WhatMayNotBeReplacedIsRefused)
{
    const CTempFolder folder;
    WriteBytes(folder.Path("readonly"), "old");
    fs::permissions(folder.Path("readonly"), fs::perms::owner_read);
    const auto link = [&](const char* target, const char* name) { // empty if the system cannot make links
        return MakeLink(target, folder.Path(name)) ? folder.Path(name) : std::string();
    };
    const std::string linked = link("readonly", "link");
    const std::string ring = link("ring", "ring");
    fs::create_directory(folder.Path("folder"));
    const size_t before = EntryCount(folder);
    const std::tuple<const char*, std::string> rows[] = {
        {"read-only file", folder.Path("readonly")},
        {"link to it", linked},
        {"folder", folder.Path("folder")},
        {"device", kDevice},
        {"links in a ring", ring},
        {"no name", ""},
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
    const bool hasLink = MakeLink("a.tmp", link);
    RemoveLeftovers(folder.Path());
    for (const std::string& path : dead)
        EXPECT_FALSE(FileExists(path)) << path;
    for (const std::string& path : kept)
        EXPECT_TRUE(FileExists(path)) << path;
    EXPECT_EQ(IsLink(link), hasLink);

    CreateFolder(folder.Path("other"));
    const std::string left = PrivateName(folder.Path("other/"), ".tmp");
    WriteBytes(left, "x");
    EXPECT_TRUE(Save(folder.Path("other/walk.htr"), "new"));
    EXPECT_FALSE(FileExists(left));
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
