#include "CAnmImage.h"
#include "CAnmImageControl.h"
#include "CImage.h"
#include "MaterialSamples.h"
#include "SceneBytes.h"
#include "TempFolder.h"

#include <gtest/gtest.h>

#include <tuple>

namespace gw {

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
