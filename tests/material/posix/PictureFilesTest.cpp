// Pictures through the codec, which is built for this system only.

#include "CAnmImage.h"
#include "CImage.h"
#include "CPicture.h"
#include "MaterialSamples.h"
#include "SceneBytes.h"
#include "TempFolder.h"

#include <gtest/gtest.h>

#include <cstring>
#include <filesystem>
#include <tuple>
#include <vector>

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

TEST(CGIFReader, ReadsLongRuns)
{
    const CTempFolder folder;
    const uint8_t blue[4] = {255, 0, 0, 255};
    const Ref<CImage> written = new CImage;
    written->Pixels().Create(700, 100, 0, blue);
    for (int x = 0; x < 700; x += 3)
        std::memset(CPixelLock(written->Pixels()).Row(x % 100) + ptrdiff_t{4} * x, 255, 4);
    ASSERT_TRUE(written->Save(folder.Path("a.gif"), 90));
    const auto picture = OpenPicture(folder.Path("a.gif"), "r");
    ASSERT_TRUE(picture);
    const CPixelView view(written->Pixels());
    for (int y = 0; y < 100; ++y)
    {
        std::vector<PixelRGBA> row(700);
        ASSERT_TRUE(picture->ReadRowRGBA(y, 0, 700, row.data())) << y;
        for (size_t x = 0; x < row.size(); ++x)
            ASSERT_EQ(row[x].r, view.Row(y)[4 * x + 2]) << x << ' ' << y;
    }
}

} // namespace gw
