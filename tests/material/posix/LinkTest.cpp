#include "CAnmImage.h"
#include "CImage.h"
#include "CImageCache.h"
#include "LinkNames.h"
#include "MaterialSamples.h"
#include "Paths.h"
#include "SceneBytes.h"
#include "TempFolder.h"

#include <gtest/gtest.h>

#include <filesystem>
#include <tuple>

namespace gw {
namespace {

constexpr std::string_view kNote = "ImageLoadFailed.txt";

// Returns a container of images that link these files.
std::string LinkingScene(std::initializer_list<std::string_view> names, std::string_view className = "CImage")
{
    CSceneBytes bytes;
    bytes.Header().EmptyThumbnail();
    uint32_t id = 0;
    for (const std::string_view name : names)
    {
        bytes.Root().Object(className, ++id, "picture").Text(name);
        if (className == "CImage")
            bytes.Add<uint16_t>(0);
    }
    return std::string(bytes.View());
}

class LinkedImage : public testing::Test
{
protected:
    LinkedImage()
    {
        Halves()->Save(m_kFolder.Path("halves.png"), 90);
        CreateFolder(m_kFolder.Path("below/deep"));
        Halves()->Save(m_kFolder.Path("below/deep/other.png"), 90);
    }

    // Loads a container in the folder that links these files.
    bool Load(COrrinStream& stream, std::initializer_list<std::string_view> names,
              std::string_view className = "CImage")
    {
        WriteBytes(m_kFolder.Path("a.orn"), LinkingScene(names, className));
        return stream.LoadFile(m_kFolder.Path("a.orn"), false) && !stream.Record().Failure();
    }
    static CImage& ImageAt(const COrrinStream& stream, size_t index)
    {
        return static_cast<CImage&>(*stream.GetRoot(index));
    }

    CTempFolder m_kFolder;
};

} // namespace

TEST(LinkNames, LeadWhereTheRuleSays)
{
    const CTempFolder folder;
    const std::string there = folder.Path("there.png");
    WriteBytes(there, "x");
    // path: below the folder /scenes, or absolute
    const std::tuple<std::string, const char*> rows[] = {
        {"a.png", "a.png"},
        {"textures\\a.png", "a.png"},
        {"textures\\wood\\a.png", "wood/a.png"},
        {"..\\a.png", "a.png"},
        {".\\wood//.\\a.png", "wood/a.png"},
        {"C:\\art\\wood\\a.png", "a.png"},
        {"\\\\server\\share\\a.png", "a.png"},
        {"/nowhere/at/all/a.png", "a.png"},
        {"C:a.png", "C:a.png"},
        {"x/../../etc/a.png", "a.png"},
        {"x\\wood\\..\\..\\..\\a.png", "a.png"},
        {"x\\wood\\..\\oak\\a.png", "oak/a.png"},
    };
    for (const auto& [name, path] : rows)
    {
        EXPECT_EQ(ResolveLinkName("/scenes", name), std::string("/scenes/") + path) << name;
        EXPECT_EQ(ResolveLinkName("", name), path) << name;
    }
    EXPECT_EQ(ResolveLinkName("/scenes", there), there) << "a file from the root that is there";
    CreateFolder(folder.Path("x/deep"));
    EXPECT_EQ(ResolveLinkName("/scenes", folder.Path("x/.././there.png")), there) << "one name for one file";
    std::filesystem::create_symlink("x/deep", folder.Path("y"));
    WriteBytes(folder.Path("x/there.png"), "x");
    EXPECT_EQ(ResolveLinkName("/scenes", folder.Path("y/../there.png")), folder.Path("y/../there.png"))
        << "a linked folder, whose .. is another one";
    EXPECT_EQ(ResolveLinkName("/scenes", folder.Path()), "/scenes/") << "a folder is no file";
}

TEST(LinkNames, AreStoredSoThatTheyLeadBack)
{
    const std::tuple<const char*, const char*> rows[] = {
        {"/scenes/a.png", "a.png"},
        {"/scenes/wood/oak/a.png", ".\\wood\\oak\\a.png"},
        {"/scenes/x/../a.png", "a.png"},
        {"/scenes/12:30.png", "12:30.png"},
        {"/scenes2/a.png", "/scenes2/a.png"},
        {"/a.png", "/a.png"},
        {"C:\\art\\a.png", "C:\\art\\a.png"},
        {"\\\\server\\a.png", "\\\\server\\a.png"},
        {"/scenes/wood/12:30.png", "/scenes/wood/12:30.png"},
    };
    for (const auto& [path, stored] : rows)
        EXPECT_EQ(StoredLinkName("/scenes", path), stored) << path;
    const std::string here = std::filesystem::current_path().string();
    EXPECT_EQ(StoredLinkName("", "a.png"), "a.png");
    EXPECT_EQ(StoredLinkName("/scenes", "a.png"), here + "/a.png") << "elsewhere a short name would be lost";
    EXPECT_EQ(StoredLinkName(here, "wood/a.png"), ".\\wood\\a.png");
}

TEST_F(LinkedImage, FileIsReadFromTheContainersFolder)
{
    COrrinStream stream;
    ASSERT_TRUE(Load(stream, {"textures\\halves.png"}));
    CImage& image = ImageAt(stream, 0);
    EXPECT_TRUE(ShowsHalves(image, 0));
    EXPECT_EQ(image.GetLinkFileName(), m_kFolder.Path("halves.png"));
    EXPECT_FALSE(FileExists(m_kFolder.Path(kNote)));

    const uint64_t alone = image.GetDiskUsed();
    ASSERT_TRUE(stream.SaveFile(m_kFolder.Path("b.orn")));
    EXPECT_EQ(ReadBytes(m_kFolder.Path("b.orn")), LinkingScene({"halves.png"})) << "the name and the storage";
    EXPECT_EQ(image.GetDiskUsed(), 24 + 6 + 7 + 4 + 10 + 2);
    EXPECT_GT(alone, image.GetDiskUsed()) << "the size is that of the stored name";

    ASSERT_TRUE(stream.SaveFile(m_kFolder.Path("below/c.orn")));
    COrrinStream again;
    ASSERT_TRUE(again.LoadFile(m_kFolder.Path("below/c.orn"), false));
    EXPECT_EQ(&ImageAt(again, 0), &image) << "found from another folder, and read once";
}

TEST_F(LinkedImage, OfOnePathIsReadOnce)
{
    COrrinStream stream;
    ASSERT_TRUE(
        Load(stream, {"halves.png", "any\\halves.png", "any\\.\\halves.png", ".\\below\\deep\\other.png"}));
    ASSERT_EQ(stream.GetRootCount(), 2u) << "the later ones receive the first";
    EXPECT_EQ(ImageAt(stream, 0).GetRefCount(), 1u);
    EXPECT_TRUE(ShowsHalves(ImageAt(stream, 1), 0));
    std::filesystem::remove(m_kFolder.Path("halves.png"));
    COrrinStream second;
    ASSERT_TRUE(Load(second, {"halves.png"}));
    EXPECT_EQ(&ImageAt(second, 0), &ImageAt(stream, 0)) << "also in another container";
    EXPECT_TRUE(SurvivesRewriting(second));

    const std::string path = ImageAt(stream, 0).GetLinkFileName();
    stream.RemoveAllRoots();
    EXPECT_NE(CImageCache::Instance().Find<CImage>(path), nullptr);
    second.RemoveAllRoots();
    EXPECT_EQ(CImageCache::Instance().Find<CImage>(path), nullptr) << "the cache keeps nothing alive";
    Ref<CImage> renamed = new CImage;
    renamed->SetLinkFileName("one");
    CImageCache::Instance().Enter("one", *renamed);
    renamed->SetLinkFileName("two");
    EXPECT_EQ(CImageCache::Instance().Find<CImage>("one"), nullptr);
}

TEST_F(LinkedImage, TakesNoMoreMemoryThanItsSceneMay)
{
    for (const char* name : {"two.png", "three.png"})
        std::filesystem::copy_file(m_kFolder.Path("halves.png"), m_kFolder.Path(name));
    for (const std::string_view className : {"CImage", "CAnmImage"})
    {
        COrrinStream stream;
        stream.SetPictureLimit(2 * 16 * 8 * 4 + (className == "CImage" ? 0 : 2 * 512));
        ASSERT_TRUE(
            Load(stream, {"none.png", "halves.png", "two.png", "three.png", "x\\three.png"}, className));
        ASSERT_EQ(stream.Record().Warnings().size(), 2u) << "both places of the one that is left out";
        EXPECT_EQ(stream.Record().Warnings()[0].reason, EFailure::SkippedPicture);
        EXPECT_EQ(stream.Record().Warnings()[0].name, m_kFolder.Path("three.png"));
        ASSERT_TRUE(stream.SaveFile(m_kFolder.Path("b.orn")));
        EXPECT_EQ(ReadBytes(m_kFolder.Path("b.orn")),
                  LinkingScene({"none.png", "halves.png", "two.png", "three.png"}, className));
        COrrinStream second;
        ASSERT_TRUE(Load(second, {"three.png"}, className));
        EXPECT_EQ(second.GetRoot(0), stream.GetRoot(3));
        EXPECT_TRUE(second.Record().Warnings().empty());
        const auto* film = dynamic_cast<CAnmImage*>(stream.GetRoot(3));
        CImage& image = film ? *film->GetFrame(0).m_spkImage : ImageAt(stream, 3);
        EXPECT_TRUE(ShowsHalves(image, 0)) << "read for the scene that has room for it";
    }
    COrrinStream names;
    names.SetPictureLimit(0);
    std::filesystem::remove(m_kFolder.Path(kNote));
    ASSERT_TRUE(Load(names, {"halves.png", "none.png"}));
    EXPECT_TRUE(ImageAt(names, 0).Pixels().IsEmpty());
    EXPECT_EQ(ImageAt(names, 0).GetLinkFileName(), m_kFolder.Path("halves.png"));
    EXPECT_TRUE(names.Record().Warnings().empty() && !FileExists(m_kFolder.Path(kNote)));
}

TEST_F(LinkedImage, KeepsWhatItHoldsWhenAnotherContainerMeetsIt)
{
    CSceneBytes bytes;
    bytes.Header().EmptyThumbnail().Root().Object("CImage", 1, "first", {0, 0, 2});
    bytes.Text("halves.png").Add<uint16_t>(0).RawData(2, 0);
    WriteBytes(m_kFolder.Path("first.orn"), bytes.View());
    COrrinStream first;
    ASSERT_TRUE(first.LoadFile(m_kFolder.Path("first.orn"), false));
    CImage& image = ImageAt(first, 0);
    ASSERT_NE(image.GetCustomData(), nullptr);

    CSceneBytes ring; // two nodes that hold each other are refused and deleted
    ring.Header().EmptyThumbnail().Root().Node(1, {2}).Node(2, {1});
    ring.Root().Object("CImage", 3, "second", {0, 0, 0}).Text("halves.png").Add<uint16_t>(0);
    WriteBytes(m_kFolder.Path("ring.orn"), ring.View());
    COrrinStream second;
    second.LoadFile(m_kFolder.Path("ring.orn"), false);
    EXPECT_EQ(second.Record().Failure().reason, EFailure::Cycle);
    ASSERT_TRUE(Load(second, {"halves.png"}));
    EXPECT_EQ(&ImageAt(second, 0), &image);
    EXPECT_NE(image.GetCustomData(), nullptr);
    EXPECT_EQ(image.NameView(), "first");
}

TEST_F(LinkedImage, ThatCannotBeReadIsNotedAndKeepsItsName)
{
    WriteBytes(m_kFolder.Path("broken.png"), "no picture");
    WriteBytes(m_kFolder.Path(kNote), "an older and longer note, which goes, however many lines it has\n");
    COrrinStream stream;
    ASSERT_TRUE(Load(stream, {"folder\\broken.png"}));
    EXPECT_TRUE(ImageAt(stream, 0).Pixels().IsEmpty());
    EXPECT_EQ(ReadBytes(m_kFolder.Path(kNote)),
              "LinkFileName = picture\nLocalLinkFileName = " + m_kFolder.Path("broken.png") + "\n");
    ASSERT_TRUE(stream.SaveFile(m_kFolder.Path("b.orn")));
    EXPECT_EQ(ReadBytes(m_kFolder.Path("b.orn")), LinkingScene({"broken.png"}));

    // Neither a folder nor a pipe is read, and nothing is written through a link.
    std::filesystem::remove(m_kFolder.Path(kNote));
    WriteBytes(m_kFolder.Path("precious"), "whole");
    std::filesystem::create_symlink("precious", m_kFolder.Path(kNote));
    ASSERT_TRUE(Load(stream, {"below", "none.png", std::string_view("\0.png", 5)}));
    EXPECT_EQ(ReadBytes(m_kFolder.Path("precious")), "whole");
    EXPECT_EQ(ImageAt(stream, 2).GetLinkFileName(), nullptr) << "a zero byte ends a name";
    EXPECT_TRUE(SurvivesRewriting(stream));
}

TEST_F(LinkedImage, InMemoryLeadsNowhere)
{
    COrrinStream stream;
    const std::string bytes = LinkingScene({"halves.png"}).substr(21);
    ASSERT_TRUE(LoadBytes(stream, std::as_bytes(std::span(bytes))));
    EXPECT_STREQ(ImageAt(stream, 0).GetLinkFileName(), "halves.png");
    EXPECT_TRUE(ImageAt(stream, 0).Pixels().IsEmpty());
    const auto written = SaveBytes(stream);
    EXPECT_EQ(std::string_view(reinterpret_cast<const char*>(written.data()), written.size()), bytes);
}

TEST_F(LinkedImage, FilmsAreLinkedLikePictures)
{
    COrrinStream stream;
    ASSERT_TRUE(Load(stream, {"x\\halves.png", "halves.png", "none.gif"}, "CAnmImage"));
    ASSERT_EQ(stream.GetRootCount(), 2u);
    const auto& film = static_cast<CAnmImage&>(*stream.GetRoot(0));
    ASSERT_EQ(film.GetFrameCount(), 1u);
    EXPECT_TRUE(ShowsHalves(*film.GetFrame(0).m_spkImage, 0));
    EXPECT_EQ(static_cast<CAnmImage&>(*stream.GetRoot(1)).GetFrameCount(), 0u);
    EXPECT_TRUE(FileExists(m_kFolder.Path(kNote)));
    ASSERT_TRUE(stream.SaveFile(m_kFolder.Path("b.orn")));
    EXPECT_EQ(ReadBytes(m_kFolder.Path("b.orn")), LinkingScene({"halves.png", "none.gif"}, "CAnmImage"));
    CCloneMap map;
    const Ref<CAnmImage> copy = static_cast<CAnmImage*>(stream.GetRoot(0)->Clone(map));
    ASSERT_NE(copy->GetFrame(0).m_spkImage.Get(), nullptr);
    EXPECT_NE(copy->GetFrame(0).m_spkImage, film.GetFrame(0).m_spkImage);
    EXPECT_EQ(copy->GetFrame(1).m_spkImage.Get(), nullptr) << "behind the last there is none";
}

} // namespace gw
