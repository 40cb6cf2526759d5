#include "Blit.h"
#include "CPixelBuffer.h"
#include "CTempStore.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <array>
#include <climits>
#include <tuple>
#include <vector>

namespace gw {
namespace {

constexpr uint8_t kPixel[4] = {1, 2, 3, 4};

std::vector<int> BytesOf(const CPixelBuffer& buffer)
{
    const CPixelView view(buffer);
    return {view.Bytes().begin(), view.Bytes().end()};
}

using testing::ElementsAre;

class EveryStorage : public testing::TestWithParam<EPixelStorage>
{
protected:
    bool IsForeign() const { return GetParam() == EPixelStorage::Foreign; }
    // Gives a buffer the storage; a foreign block holds 3 x 2 pixels of 3 bytes in aligned rows.
    void Prepare(CPixelBuffer& buffer)
    {
        buffer.SetRowAlignment(true);
        EXPECT_TRUE(IsForeign() ? buffer.Attach(m_aBlock.data(), 3, 2, 1) : buffer.SetStorage(GetParam()));
    }

    std::array<uint8_t, 25> m_aBlock{};
};

} // namespace

TEST(CPixelBuffer, BlocksHaveTheSizeThatTheFormatSays)
{
    // stride: 0 if refused
    // block: 0 if refused
    const std::tuple<int32_t, int32_t, int32_t, bool, size_t, size_t> rows[] = {
        {5, 1, 0, false, 20, 20},       {5, 1, 1, false, 15, 16}, {5, 1, 1, true, 16, 17},
        {5, 3, 2, false, 10, 32},       {5, 3, 3, true, 12, 38},  {5, 3, 4, false, 10, 32},
        {5, 3, 5, true, 8, 27},         {1, 1, 5, false, 1, 4},   {5, 3, 6, false, 0, 0},
        {5, 3, -1, false, 0, 0},        {0, 3, 0, false, 0, 0},   {5, 0, 1, false, 0, 0},
        {-5, 3, 0, false, 0, 0},        {5, -3, 0, false, 0, 0},  {INT_MAX, 2, 0, true, 0, 0},
        {65536, 65536, 5, false, 0, 0},
    };
    for (const auto& [width, height, format, aligned, stride, block] : rows)
    {
        SCOPED_TRACE(testing::Message() << width << " x " << height << " in " << format);
        CPixelBuffer buffer;
        EXPECT_TRUE(buffer.SetRowAlignment(aligned));
        EXPECT_EQ(buffer.Create(width, height, format), block != 0);
        EXPECT_EQ(buffer.GetStride(), stride);
        EXPECT_EQ(buffer.GetBlockBytes(), block);
        EXPECT_EQ(buffer.SetRowAlignment(!aligned), block == 0);
    }
}

TEST_P(EveryStorage, CreateFillsClearsAndRefusesAsStated)
{
    CPixelBuffer other; // keeps the temporary file, so that blocks are reused
    ASSERT_TRUE(other.SetStorage(EPixelStorage::TempStore) && other.Create(1, 1, 0));
    m_aBlock.fill(9);
    CPixelBuffer buffer;
    Prepare(buffer);
    ASSERT_TRUE(buffer.Create(3, 2, 1, kPixel));
    EXPECT_THAT(BytesOf(buffer),
                ElementsAre(1, 2, 3, 1, 2, 3, 1, 2, 3, 0, 0, 0, 1, 2, 3, 1, 2, 3, 1, 2, 3, 0, 0, 0));
    EXPECT_EQ(buffer.GetHandle() >= kLeastTempHandle, GetParam() == EPixelStorage::TempStore);
    EXPECT_FALSE(buffer.Create(3, 2, 6)) << "leaves everything as it was";
    EXPECT_EQ(BytesOf(buffer)[4], 2);
    ASSERT_TRUE(buffer.Create(3, 2, 1));
    EXPECT_EQ(BytesOf(buffer), std::vector<int>(24));
    EXPECT_EQ(buffer.Create(1, 2, 0, kPixel), !IsForeign());
    EXPECT_EQ(BytesOf(buffer), IsForeign() ? std::vector<int>(24) : (std::vector{1, 2, 3, 4, 1, 2, 3, 4}));
    EXPECT_TRUE(buffer.Free());
    EXPECT_TRUE(buffer.IsEmpty());
    EXPECT_EQ(buffer.GetHandle(), 0u);
    EXPECT_EQ(m_aBlock[24], 9) << "what belongs to others stays whole";
}

TEST_P(EveryStorage, CopiesTakeEverythingButWhereItIsKept)
{
    CPixelBuffer source;
    source.SetStorage(EPixelStorage::TempStore);
    source.SetRowAlignment(true);
    source.SetResolution(72, 300);
    source.Create(3, 2, 1, kPixel);
    CPixelLock(source).Row(1)[4] = 99;
    CPixelBuffer copy;
    Prepare(copy);
    ASSERT_TRUE(copy.Copy(source));
    EXPECT_EQ(BytesOf(copy), BytesOf(source));
    EXPECT_EQ(BytesOf(copy)[16], 99);
    EXPECT_EQ(copy.GetStorage(), GetParam());
    EXPECT_EQ(copy.Layout().m_iVerticalResolution, 300);
    EXPECT_FALSE(copy.Copy(CPixelBuffer())) << "of nothing there is no copy";
    source.Create(4, 2, 1);
    EXPECT_EQ(copy.Copy(source), !IsForeign());
    const CPixelBuffer made(copy);
    EXPECT_EQ(BytesOf(made), BytesOf(copy));
    EXPECT_NE(made.GetStorage(), EPixelStorage::Foreign) << "a copy owns its pixels";
}

TEST_P(EveryStorage, WhatIsLockedStaysWhereItIs)
{
    CPixelBuffer buffer;
    EXPECT_FALSE(CPixelLock(buffer));
    Prepare(buffer);
    buffer.Create(3, 2, 1);
    const uint32_t revision = buffer.GetRevision();
    {
        const CPixelView view(buffer);
        const CPixelView second(buffer);
        EXPECT_EQ(view.Row(1), second.Row(0) + buffer.GetStride());
        EXPECT_EQ(buffer.GetLockCount(), 2);
        EXPECT_EQ(buffer.GetRevision(), revision) << "looking changes nothing";
        EXPECT_FALSE(buffer.Free());
        EXPECT_FALSE(buffer.Create(4, 4, 0));
        EXPECT_FALSE(buffer.Attach(m_aBlock.data(), 1, 1, 5));
        EXPECT_TRUE(buffer.Create(3, 2, 1, kPixel)) << "the same size keeps its block";
        EXPECT_EQ(view.Row(1)[3], 1);
    }
    EXPECT_EQ(buffer.GetLockCount(), 0);
    EXPECT_NE(buffer.GetRevision(), revision);
}

INSTANTIATE_TEST_SUITE_P(CPixelBuffer, EveryStorage,
                         testing::Values(EPixelStorage::Heap, EPixelStorage::TempStore,
                                         EPixelStorage::Foreign));

TEST(Blit, MixesByOpacityInAllPairings)
{
    const uint8_t to[4] = {100, 100, 100, 100};
    const uint8_t from[4] = {0, 200, 255, 20};
    const std::tuple<int32_t, int32_t, uint8_t, std::vector<int>> rows[] = {
        {0, 0, 255, {0, 200, 255, 20}},  {0, 0, 51, {80, 120, 131, 84}}, {0, 1, 255, {0, 200, 255, 255}},
        {0, 1, 51, {80, 120, 131, 131}}, {1, 0, 255, {0, 200, 255}},     {1, 0, 51, {80, 120, 131}},
        {1, 1, 255, {0, 200, 255}},      {1, 1, 128, {50, 150, 178}},    {0, 0, 0, {100, 100, 100, 100}},
    };
    for (const auto& [toFormat, fromFormat, opacity, pixel] : rows)
    {
        SCOPED_TRACE(testing::Message() << fromFormat << " on " << toFormat << " by " << int(opacity));
        CPixelBuffer destination;
        CPixelBuffer source;
        destination.SetStorage(EPixelStorage::TempStore);
        destination.Create(1, 1, toFormat, to);
        source.Create(1, 1, fromFormat, from);
        EXPECT_TRUE(Blit(destination, 0, 0, source, 0, 0, 1, 1, opacity));
        EXPECT_EQ(BytesOf(destination), pixel);
    }
}

TEST(Blit, IsCutToBothPictures)
{
    // A source of 3 x 3 pixels numbered from 1, on a destination of 4 x 3 zeros.
    const std::tuple<const char*, int, int, int, int, int, int, std::vector<int>> rows[] = {
        {"inside", 1, 1, 0, 0, 2, 2, {0, 0, 0, 0, 0, 1, 2, 0, 0, 4, 5, 0}},
        {"left and above", -1, -2, 0, 0, 3, 3, {8, 9, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0}},
        {"right and below", 3, 2, 0, 0, 3, 3, {0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 1}},
        {"source begins out", 0, 0, -1, -1, 3, 3, {0, 0, 0, 0, 0, 1, 2, 0, 0, 4, 5, 0}},
        {"source ends", 0, 0, 2, 2, 9, 9, {9, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0}},
        {"all beside", 4, 0, 0, 0, 3, 3, {0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0}},
        {"nothing", 0, 0, 0, 0, -3, 3, {0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0}},
        {"far away", INT_MIN, INT_MIN, 0, 0, INT_MAX, INT_MAX, {0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0}},
        {"far in the source", 0, 0, 0, INT_MIN, INT_MAX, INT_MAX, {0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0}},
    };
    CPixelBuffer source;
    source.Create(3, 3, 1);
    for (int32_t i = 0; i < 9; ++i)
        CPixelLock(source).Row(i / 3)[size_t{3} * (i % 3)] = static_cast<uint8_t>(i + 1);
    for (const auto& [what, x, y, sourceX, sourceY, width, height, wanted] : rows)
    {
        CPixelBuffer destination;
        destination.Create(4, 3, 0);
        EXPECT_TRUE(Blit(destination, x, y, source, sourceX, sourceY, width, height, 255));
        std::vector<int> blues;
        blues.reserve(12);
        for (int32_t i = 0; i < 12; ++i)
            blues.push_back(CPixelView(destination).Row(i / 4)[size_t{4} * (i % 4)]);
        EXPECT_EQ(blues, wanted) << what;
    }
}

TEST(Blit, OverlappingPartsOfOnePictureAreTakenAsTheyWere)
{
    CPixelBuffer buffer;
    buffer.Create(4, 1, 1);
    for (int32_t x = 0; x < 4; ++x)
        CPixelLock(buffer).Row(0)[size_t{3} * x] = static_cast<uint8_t>(x + 1);
    EXPECT_TRUE(Blit(buffer, 1, 0, buffer, 0, 0, 3, 1, 255));
    EXPECT_THAT(BytesOf(buffer), ElementsAre(1, 0, 0, 1, 0, 0, 2, 0, 0, 3, 0, 0));
}

TEST(Blit, RefusesOtherFormatsAndEmptyPictures)
{
    CPixelBuffer known;
    known.Create(2, 2, 0);
    EXPECT_FALSE(Blit(known, 0, 0, CPixelBuffer(), 0, 0, 2, 2, 255));
    for (int32_t format = 2; format < 6; ++format)
    {
        CPixelBuffer other;
        other.Create(2, 2, format, kPixel);
        EXPECT_FALSE(Blit(known, 0, 0, other, 0, 0, 2, 2, 255)) << format;
        EXPECT_FALSE(Blit(other, 0, 0, known, 0, 0, 2, 2, 255)) << format;
    }
    EXPECT_EQ(BytesOf(known), std::vector<int>(16));
}

} // namespace gw
