#include "CAnmImage.h"
#include "CImage.h"
#include "CImageCache.h"
#include "LinkNames.h"
#include "MaterialSamples.h"
#include "Paths.h"
#include "SceneBytes.h"
#include "TempFolder.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <filesystem>

namespace gw {

namespace {

constexpr std::string_view kNote = "ImageLoadFailed.txt";

// A picture of 16 x 8 pixels that is blue on the left and orange on the right, which JPEG keeps well.
void DrawHalves(CPixelBuffer& pixels, int32_t format = 0)
{
    const uint8_t blue[4] = {250, 20, 10, 255};
    const uint8_t orange[4] = {10, 120, 240, 255};
    pixels.Create(16, 8, format, blue);
    const CPixelLock lock(pixels);
    for (int32_t y = 0; y < 8; ++y)
    {
        for (int32_t x = 8; x < 16; ++x)
            std::memcpy(lock.Row(y) + x * pixels.GetBytesPerPixel(), orange,
                        size_t(pixels.GetBytesPerPixel()));
    }
}

Ref<CImage> Halves(int32_t format = 0)
{
    Ref<CImage> image = new CImage;
    DrawHalves(image->Pixels(), format);
    return image;
}

bool ShowsHalves(CImage& image, int tolerance)
{
    const CPixelBuffer& pixels = image.Pixels();
    const CPixelView view(pixels);
    if (pixels.GetWidth() != 16 || pixels.GetHeight() != 8 || pixels.GetFormat() != 0)
        return false;
    const auto isNear = [&](int32_t x, std::initializer_list<int> color) {
        const uint8_t* byte = view.Row(5) + x * 4;
        return std::ranges::all_of(color, [&](int c) { return std::abs(*byte++ - c) <= tolerance; });
    };
    return isNear(2, {250, 20, 10, 255}) && isNear(13, {10, 120, 240, 255});
}

// A container of images that link files, by their names.
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

    // Loads a container in the folder that links these.
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

TEST(PictureFiles, FormatsKeepPixelsAndResolution)
{
    const struct
    {
        const char* name;
        int32_t format;
        int tolerance;
        int32_t resolution; // 96 where the format keeps none
    } rows[] = {
        {"a.png",  0, 0, 300},
        {"a.PNG",  1, 0, 300},
        {"a.bmp",  0, 0, 300},
        {"a.tga",  1, 0, 96 },
        {"a.tif",  0, 0, 300},
        {"a.gif",  0, 2, 96 },
        {"a.jpg",  1, 6, 300},
        {"a.jpeg", 0, 6, 300},
        {"a.pcx",  1, 0, 300},
        {"a.ppm",  1, 0, 96 },
    };
    const CTempFolder folder;
    for (const auto& row : rows)
    {
        SCOPED_TRACE(row.name);
        const Ref<CImage> image = Halves(row.format);
        image->Pixels().SetResolution(72, 300);
        ASSERT_TRUE(image->Save(folder.Path(row.name), 95));
        const Ref<CImage> again = new CImage;
        ASSERT_TRUE(again->Load(folder.Path(row.name)));
        EXPECT_TRUE(ShowsHalves(*again, row.tolerance));
        EXPECT_NEAR(again->Pixels().Layout().m_iVerticalResolution, row.resolution, 1);
    }
}

TEST(PictureFiles, KeepAlphaWhereTheFormatHasIt)
{
    const CTempFolder folder;
    for (const char* name : {"a.png", "a.tga", "a.tif", "a.bmp"})
    {
        const uint8_t pixel[4] = {200, 100, 50, 7};
        const Ref<CImage> image = new CImage;
        image->Pixels().Create(5, 5, 0, pixel);
        ASSERT_TRUE(image->Save(folder.Path(name), 95));
        ASSERT_TRUE(image->Load(folder.Path(name)));
        EXPECT_EQ(std::memcmp(CPixelView(image->Pixels()).Row(4), pixel, 4), 0) << name;
    }
}

TEST(PictureFiles, WhatAFileBeginsWithTellsMoreThanItsName)
{
    const CTempFolder folder;
    Halves()->Save(folder.Path("a.png"), 90);
    for (const char* name : {"a.jpg", "a.tga", "a", "a.svg"})
    {
        std::filesystem::copy_file(folder.Path("a.png"), folder.Path(name));
        const Ref<CImage> image = new CImage;
        EXPECT_TRUE(image->Load(folder.Path(name))) << name;
    }
}

TEST(PictureFiles, WhatIsNoPictureLeavesAnEmptyImage)
{
    const CTempFolder folder;
    Halves()->Save(folder.Path("a.png"), 90);
    Halves()->Save(folder.Path("a.tga"), 90);
    const std::string png = ReadBytes(folder.Path("a.png"));
    WriteBytes(folder.Path("empty.png"), "");
    WriteBytes(folder.Path("text.png"), "no picture at all");
    WriteBytes(folder.Path("drawing.svg"), "<svg xmlns='http://www.w3.org/2000/svg' width='9' height='9'/>");
    WriteBytes(folder.Path("drawing.mvg"), "push graphic-context viewbox 0 0 9 9 pop graphic-context");
    WriteBytes(folder.Path("name.txt"), "a.png");
    // 60,000 x 60,000 pixels, of which there is not one.
    WriteBytes(folder.Path("huge.pgm"), "P5 60000 60000 255\n");
    WriteBytes(folder.Path("cut.png"), png.substr(0, 30));
    const std::string names[] = {"empty.png", "text.png", "drawing.svg", "drawing.mvg", "name.txt",
                                 "huge.pgm",  "cut.png",  "none.png",    "/",           "@name.txt",
                                 "png:a.png", "a.png[0]", "a.png ",      "fd:0",        "/dev/null"};
    for (const std::string& name : names)
    {
        const Ref<CImage> image = Halves();
        EXPECT_FALSE(image->Load(folder.Path(name))) << name;
        EXPECT_TRUE(image->Pixels().IsEmpty()) << name;
        EXPECT_EQ(image->Pixels().GetWidth(), 0);
    }
    EXPECT_FALSE(Halves()->Save(folder.Path("a.svg"), 90));
    EXPECT_FALSE(Halves()->Save(folder.Path("a"), 90));
    EXPECT_FALSE(Halves()->Save(folder.Path("none/a.png"), 90));
    EXPECT_FALSE(Halves(2)->Save(folder.Path("a.png"), 90)) << "a format that has no colours that are known";
    EXPECT_FALSE(Ref<CImage>(new CImage)->Save(folder.Path("a.png"), 90));
    EXPECT_EQ(ReadBytes(folder.Path("a.png")), png) << "a failed write leaves the old file";
}

// Every beginning of a picture is read as far as it goes or refused.
TEST(PictureFiles, CutPicturesDoNoHarm)
{
    const CTempFolder folder;
    for (const char* name : {"a.jpg", "a.png", "a.gif", "a.bmp", "a.tif", "a.pcx"})
    {
        Halves()->Save(folder.Path(name), 90);
        const std::string whole = ReadBytes(folder.Path(name));
        for (size_t size = 0; size < whole.size(); size += 7)
        {
            WriteBytes(folder.Path(name), std::string_view(whole).substr(0, size));
            const Ref<CImage> image = new CImage;
            const bool loaded = image->Load(folder.Path(name));
            ASSERT_EQ(loaded, !image->Pixels().IsEmpty()) << name << ' ' << size;
        }
    }
}

TEST(CImage, PlainPixelsAreWrittenAsTheFormatSays)
{
    const Ref<CImage> image = PlainImage("p", 5, EPixelStorage::TempStore);
    COrrinStream stream;
    stream.AddRoot(image.Get());
    CSceneBytes bytes = Scene().Root().Object("CImage", 1, "p").Text("").Add<uint16_t>(1).Byte(0);
    bytes.Words({3, 2, 5}).Add<uint16_t>(1).Words({72, 300, 1}).Raw("\1\2\3\4\5\6\7\x08");
    EXPECT_EQ(SaveBytes(stream), bytes.Bytes());
    COrrinStream again;
    ASSERT_TRUE(LoadBytes(again, bytes.Bytes()));
    EXPECT_EQ(SaveBytes(again), bytes.Bytes());
    EXPECT_GE(static_cast<CImage&>(*again.GetRoot(0)).Pixels().GetHandle(), 65'537u);
}

TEST(CImage, OddPixelsOfAFileAreReadOrRefused)
{
    const struct
    {
        const char* what;
        uint32_t width, height, format, presence;
        uint16_t storage;
        bool whole;
    } rows[] = {
        {"a size without pixels", 10,         10,         0, 0, 0,  true },
        {"no width",              0,          9,          0, 1, 1,  true },
        {"no height",             9,          0,          0, 1, 0,  true },
        {"as many as there are",  2,          2,          0, 9, 77, true },
        {"no such format",        1,          1,          6, 1, 0,  false},
        {"below 0",               0xffffffff, 1,          0, 1, 0,  false},
        {"above 0 as a product",  0xffffffff, 0xffffffff, 0, 1, 1,  false},
        {"more than there are",   99,         99,         5, 1, 0,  false},
        {"a product of 34 bits",  65536,      65536,      0, 1, 1,  false},
    };
    for (const auto& row : rows)
    {
        SCOPED_TRACE(row.what);
        CSceneBytes bytes = Scene().Root().Object("CImage", 1).Text("").Add(row.storage).Byte(0);
        bytes.Words({row.width, row.height, row.format}).Add<uint16_t>(0).Words({96, 96, row.presence});
        const bool hasPixels = row.width == 2;
        bytes.Raw(hasPixels ? "sixteen bytes..." : "");
        COrrinStream stream;
        ASSERT_EQ(LoadBytes(stream, bytes.Bytes()), row.whole);
        if (!row.whole)
            continue;
        CImage& image = static_cast<CImage&>(*stream.GetRoot(0));
        EXPECT_EQ(image.Pixels().IsEmpty(), !hasPixels);
        EXPECT_EQ(image.Pixels().GetStorage(),
                  row.storage == 1 ? EPixelStorage::TempStore : EPixelStorage::Heap);
        EXPECT_TRUE(SurvivesRewriting(stream));
    }
}

TEST(EmbeddedJPEG, IsMadeForASaveAndDecodedWhenAsked)
{
    const Ref<CImage> image = Halves();
    COrrinStream stream;
    stream.AddRoot(image.Get());
    const std::vector<std::byte> first = SaveBytes(stream);
    EXPECT_EQ(SaveBytes(stream), first) << "the same size and bytes every time";
    COrrinStream again;
    ASSERT_TRUE(LoadBytes(again, first));
    CImage& loaded = static_cast<CImage&>(*again.GetRoot(0));
    EXPECT_EQ(SaveBytes(again), first) << "kept as it was read";
    EXPECT_TRUE(ShowsHalves(loaded, 6));
    EXPECT_EQ(SaveBytes(again), first) << "and after a look at it";
    const Ref<CImage> copy = static_cast<CImage*>(loaded.CreateClone());
    EXPECT_TRUE(ShowsHalves(*copy, 6));
    EXPECT_EQ(copy->GetDiskUsed(), loaded.GetDiskUsed());

    CPixelLock(loaded.Pixels()).Row(0)[0] ^= 0x80;
    const std::vector<std::byte> changed = SaveBytes(again);
    EXPECT_NE(changed, first) << "but not once its pixels have changed";
    EXPECT_EQ(changed.size(), 58 + 14 + loaded.GetDiskUsed());
}

TEST(EmbeddedJPEG, WhatCannotBeOneIsNotLost)
{
    const Ref<CImage> gray = PlainImage("gray", 5);
    gray->m_bJPEG = true;
    COrrinStream stream;
    stream.AddRoot(gray.Get());
    COrrinStream again;
    ASSERT_TRUE(LoadBytes(again, SaveBytes(stream)));
    EXPECT_EQ(static_cast<CImage&>(*again.GetRoot(0)).Pixels().GetWidth(), 3);

    CSceneBytes broken =
        Scene().Root().Object("CImage", 1).Text("").Add<uint16_t>(0).Byte(1).Text("\xff\xd8\xffno JPEG");
    ASSERT_TRUE(LoadBytes(again, broken.Bytes()));
    EXPECT_TRUE(static_cast<CImage&>(*again.GetRoot(0)).Pixels().IsEmpty());
    EXPECT_EQ(SaveBytes(again), broken.Bytes());
}

TEST(LinkNames, LeadWhereTheRuleSays)
{
    const CTempFolder folder;
    const std::string there = folder.Path("there.png");
    WriteBytes(there, "x");
    const struct
    {
        std::string name;
        const char* path; // below the folder /scenes, or from the root
    } rows[] = {
        {"a.png",                    "a.png"     },
        {"textures\\a.png",          "a.png"     },
        {"textures/a.png",           "a.png"     },
        {"textures\\wood\\a.png",    "wood/a.png"},
        {"..\\a.png",                "a.png"     },
        {".\\wood//.\\a.png",        "wood/a.png"},
        {"C:\\art\\wood\\a.png",     "a.png"     },
        {"\\\\server\\share\\a.png", "a.png"     },
        {"/nowhere/at/all/a.png",    "a.png"     },
        {"C:a.png",                  "C:a.png"   },
        {"\\a.png",                  "a.png"     },
    };
    for (const auto& row : rows)
    {
        EXPECT_EQ(ResolveLinkName("/scenes", row.name), std::string("/scenes/") + row.path) << row.name;
        EXPECT_EQ(ResolveLinkName("", row.name), row.path) << row.name;
    }
    EXPECT_EQ(ResolveLinkName("/scenes", there), there) << "a file from the root that is there";
    EXPECT_EQ(ResolveLinkName("/scenes", folder.Path()), "/scenes/") << "a folder is no file";
}

TEST(LinkNames, AreStoredSoThatTheyLeadBack)
{
    const struct
    {
        const char* path;
        const char* stored;
    } rows[] = {
        {"/scenes/a.png",          "a.png"                 },
        {"/scenes/wood/oak/a.png", ".\\wood\\oak\\a.png"   },
        {"/scenes/x/../a.png",     "a.png"                 },
        {"/scenes/12:30.png",      "12:30.png"             },
        {"/scenes2/a.png",         "/scenes2/a.png"        },
        {"/a.png",                 "/a.png"                },
        {"C:\\art\\a.png",         "C:\\art\\a.png"        },
        {"\\\\server\\a.png",      "\\\\server\\a.png"     },
        {"/scenes/wood/12:30.png", "/scenes/wood/12:30.png"},
    };
    for (const auto& row : rows)
        EXPECT_EQ(StoredLinkName("/scenes", row.path), row.stored) << row.path;
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

TEST_F(LinkedImage, KeepsWhatItHoldsWhenAnotherContainerMeetsIt)
{
    CSceneBytes bytes;
    bytes.Header()
        .EmptyThumbnail()
        .Root()
        .Object("CImage", 1, "first", {0, 0, 2})
        .Text("halves.png")
        .Add<uint16_t>(0);
    bytes.RawData(2, 0);
    WriteBytes(m_kFolder.Path("first.orn"), bytes.View());
    COrrinStream first;
    ASSERT_TRUE(first.LoadFile(m_kFolder.Path("first.orn"), false));
    CImage& image = ImageAt(first, 0);
    ASSERT_NE(image.GetCustomData(), nullptr);

    CSceneBytes ring; // two nodes that hold each other are refused and fall apart
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

// Two frames: a red one of 2 x 2 pixels shown for 70 hundredths, and a green pixel at 1, 0 for 5.
TEST(CAnmImage, ReadsEveryFrameOfAFilmWithPlaceAndDelay)
{
    constexpr char kFilm[] = "GIF89a\2\0\2\0\x80\0\0\xff\0\0\0\xff\0"
                             "!\xf9\4\0\x46\0\0\0,\0\0\0\0\2\0\2\0\0\2\2\x84\x51\0"
                             "!\xf9\4\0\5\0\0\0,\1\0\0\0\1\0\1\0\0\2\2L\1\0;";
    const CTempFolder folder;
    WriteBytes(folder.Path("film.gif"), std::string_view(kFilm, sizeof kFilm - 1));
    const Ref<CAnmImage> film = new CAnmImage;
    ASSERT_TRUE(film->Load(folder.Path("film.gif")));
    ASSERT_EQ(film->GetFrameCount(), 2u);
    const struct
    {
        int32_t left, size;
        uint32_t delay;
        uint8_t green;
    } rows[] = {
        {0, 2, 70, 0  },
        {1, 1, 5,  255},
    };
    for (size_t i = 0; i < 2; ++i)
    {
        const CFilmFrame& frame = film->GetFrame(i);
        EXPECT_EQ(frame.m_iLeft, rows[i].left);
        EXPECT_EQ(frame.m_uiDelay, rows[i].delay);
        EXPECT_EQ(frame.m_spkImage->Pixels().GetWidth(), rows[i].size);
        EXPECT_EQ(CPixelView(frame.m_spkImage->Pixels()).Row(0)[1], rows[i].green);
    }
    const Ref<CImage> first = new CImage;
    ASSERT_TRUE(first->Load(folder.Path("film.gif"))) << "as a picture it is its first frame";
    EXPECT_EQ(first->Pixels().GetWidth(), 2);
    EXPECT_FALSE(film->Load(folder.Path("none.gif")));
    EXPECT_EQ(film->GetFrameCount(), 0u);
}

} // namespace gw
