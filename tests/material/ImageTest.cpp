#include "CAnmImage.h"
#include "CAnmImageControl.h"
#include "CImage.h"
#include "MaterialSamples.h"
#include "SceneBytes.h"
#include "TempFolder.h"

#include <gtest/gtest.h>

#include <filesystem>
#include <tuple>

namespace gw {

TEST(PictureFiles, FormatsKeepPixelsAndResolution)
{
    // resolution: 96 if the format does not store it
    const std::tuple<const char*, int32_t, int, int32_t, bool> rows[] = {
        {"a.png", 0, 0, 300, true},  {"a.PNG", 1, 0, 300, true},   {"a.bmp", 0, 0, 300, true},
        {"a.tga", 1, 0, 96, true},   {"a.tif", 0, 0, 300, true},   {"a.gif", 0, 2, 96, false},
        {"a.jpg", 1, 6, 300, false}, {"a.jpeg", 0, 6, 300, false}, {"a.pcx", 1, 0, 300, false},
        {"a.ppm", 1, 0, 96, false},
    };
    const CTempFolder folder;
    for (const auto& [name, format, tolerance, resolution, hasAlpha] : rows)
    {
        SCOPED_TRACE(name);
        const std::string path = folder.Path(name);
        const Ref<CImage> image = Halves(format);
        image->Pixels().SetResolution(72, 300);
        ASSERT_TRUE(image->Save(path, 95));
        const Ref<CImage> again = new CImage;
        ASSERT_TRUE(again->Load(path));
        EXPECT_TRUE(ShowsHalves(*again, tolerance));
        EXPECT_NEAR(again->Pixels().Layout().m_iVerticalResolution, resolution, 1);
        const uint8_t pixel[4] = {200, 100, 50, 7};
        image->Pixels().Create(5, 5, 0, pixel);
        ASSERT_TRUE(image->Save(path, 95) && image->Load(path));
        EXPECT_TRUE(!hasAlpha || std::memcmp(CPixelView(image->Pixels()).Row(4), pixel, 4) == 0);
    }
}

TEST(PictureFiles, PrintColorsBecomeScreenColors)
{
    using namespace std::string_literals;
    const CTempFolder folder;
    // One pixel of magenta and yellow, one plane each; 255 means no ink.
    WriteBytes(folder.Path("red.psd"), "8BPS\0\1\0\0\0\0\0\0\0\4\0\0\0\1\0\0\0\1\0\x8\0\4"s +
                                           std::string(14, '\0') + "\xff\0\0\xff"s);
    const Ref<CImage> image = new CImage;
    ASSERT_TRUE(image->Load(folder.Path("red.psd")));
    const uint8_t red[4] = {0, 0, 255, 255};
    EXPECT_EQ(std::memcmp(CPixelView(image->Pixels()).Row(0), red, 4), 0);
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
    const std::string png = ReadBytes(folder.Path("a.png"));
    WriteBytes(folder.Path("empty.png"), "");
    WriteBytes(folder.Path("text.png"), "no picture at all");
    WriteBytes(folder.Path("drawing.svg"), "<svg xmlns='http://www.w3.org/2000/svg' width='9' height='9'/>");
    WriteBytes(folder.Path("drawing.mvg"), "push graphic-context viewbox 0 0 9 9 pop graphic-context");
    WriteBytes(folder.Path("name.txt"), "a.png");
    // 60,000 x 60,000 pixels, none of which is in the file.
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

TEST(CImage, OddPixelsOfAFileAreReadOrRefused)
{
    const std::tuple<const char*, uint32_t, uint32_t, uint32_t, uint32_t, uint16_t, bool> rows[] = {
        {"a size without pixels", 10, 10, 0, 0, 0, true},
        {"no width", 0, 9, 0, 1, 1, true},
        {"no height", 9, 0, 0, 1, 0, true},
        {"as many as there are", 2, 2, 0, 9, 77, true},
        {"no such format", 1, 1, 6, 1, 0, false},
        {"below 0", 0xffffffff, 1, 0, 1, 0, false},
        {"above 0 as a product", 0xffffffff, 0xffffffff, 0, 1, 1, false},
        {"more than there are", 99, 99, 5, 1, 0, false},
        {"a product of 34 bits", 65536, 65536, 0, 1, 1, false},
    };
    for (const auto& [what, width, height, format, presence, storage, whole] : rows)
    {
        SCOPED_TRACE(what);
        CSceneBytes bytes = Scene().Root().Object("CImage", 1).Text("").Add(storage).Byte(0);
        bytes.Words({width, height, format}).Add<uint16_t>(0).Words({96, 96, presence});
        const bool hasPixels = width == 2;
        bytes.Raw(hasPixels ? "sixteen bytes..." : "");
        COrrinStream stream;
        ASSERT_EQ(LoadBytes(stream, bytes.Bytes()), whole);
        if (!whole)
            continue;
        CImage& image = static_cast<CImage&>(*stream.GetRoot(0));
        EXPECT_EQ(image.Pixels().IsEmpty(), !hasPixels);
        EXPECT_EQ(image.Pixels().GetStorage(), storage == 1 ? EPixelStorage::TempStore : EPixelStorage::Heap);
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

// Two frames: a red one of 2 x 2 pixels shown for 70 hundredths, and a green pixel at (1, 0) shown for 5.
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
    const std::tuple<int32_t, int32_t, uint32_t, int> frames[] = {{0, 2, 70, 0}, {1, 1, 5, 255}};
    for (size_t i = 0; i < 2; ++i)
    {
        const FilmFrame& frame = film->GetFrame(i);
        const CPixelBuffer& pixels = frame.m_spkImage->Pixels();
        const int green = CPixelView(pixels).Row(0)[1];
        EXPECT_EQ(std::tuple(frame.m_iLeft, pixels.GetWidth(), frame.m_uiDelay, green), frames[i]);
    }
    const Ref<CImage> first = new CImage;
    ASSERT_TRUE(first->Load(folder.Path("film.gif"))) << "as a picture it is its first frame";
    EXPECT_EQ(first->Pixels().GetWidth(), 2);
    EXPECT_FALSE(film->Load(folder.Path("none.gif")));
    EXPECT_EQ(film->GetFrameCount(), 0u);
}

TEST(CAnmImageControl, DrawsTheFrameOfItsTimeAtItsPlace)
{
    const auto dot = [](uint8_t shade) {
        Ref<CImage> image = new CImage;
        const uint8_t color[4] = {shade, shade, shade, 255};
        image->Pixels().Create(1, 1, 0, color);
        return image;
    };
    const Ref<CAnmImage> film = new CAnmImage;
    film->AddFrame({0, 50, 0, 0, {}, dot(10).Get()});
    film->AddFrame({0, 7, 1, 0, {}, dot(20).Get()}); // starts after its own delay: at 70
    film->AddFrame({0, 2, 2, 0, {}, nullptr});       // at 90, and shows nothing
    const Ref<CImage> screen = new CImage;
    screen->Pixels().Create(3, 1, 0);
    const Ref<CAnmImageControl> control = new CAnmImageControl;
    control->m_fEndTime = 1000.0f;
    ASSERT_TRUE(screen->AttachControl(control.Get()));
    EXPECT_FALSE(control->Update(0.0f)) << "without a film";
    control->SetFilm(film.Get());
    uint32_t stamp = screen->m_uiChangeStamp;
    for (const auto& [time, left, right] :
         {std::tuple{69.0f, 10, 0}, {70.0f, 0, 20}, {500.0f, 0, 0}, {1.0f, 10, 0}})
    {
        SCOPED_TRACE(time);
        screen->Pixels().Create(3, 1, 0);
        EXPECT_TRUE(control->Update(time));
        EXPECT_EQ(screen->m_uiChangeStamp, ++stamp);
        const CPixelView view(screen->Pixels());
        EXPECT_EQ(view.Row(0)[0], left);
        EXPECT_EQ(view.Row(0)[4], right);
    }
    control->m_bActive = false;
    EXPECT_FALSE(control->Update(70.0f));
    EXPECT_EQ(screen->m_uiChangeStamp, stamp);
}

} // namespace gw
