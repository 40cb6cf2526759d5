// GIF files: known bytes, codes of every size from the test's own encoder, and damage.

#include "CGIFReader.h"
#include "CPicInput.h"
#include "DriverSamples.h"
#include "TempFolder.h"

#include <algorithm>
#include <bit>
#include <cstring>
#include <gtest/gtest.h>
#include <random>
#include <string>
#include <vector>

namespace gw {
namespace {

using Pixels = std::vector<uint8_t>;

// What the encoder does when the reader's table is full.
enum class EFull
{
    Clear, ///< starts with a new table
    Keep,  ///< continues with codes of 12 bits
};

// Encodes each pixel by a code of its own: the codes grow as if it made use of the reader's table.
std::string Encoded(const Pixels& pixels, unsigned pixelBits, EFull full)
{
    const unsigned clear = 1u << pixelBits;
    unsigned last = clear + 1; // the highest code in use
    std::string bytes;
    uint64_t bits = 0;
    int held = 0;
    const auto put = [&](unsigned code) {
        bits |= uint64_t{code} << held;
        for (held += std::min(12, static_cast<int>(std::bit_width(last))); held >= 8; held -= 8, bits >>= 8)
            bytes += static_cast<char>(bits);
    };
    put(clear);
    for (const uint8_t pixel : pixels)
    {
        put(pixel);
        if (last < 4095)
            ++last;
        else if (full == EFull::Clear)
        {
            put(clear);
            last = clear + 1;
        }
    }
    put(clear + 1);
    return bytes + static_cast<char>(bits);
}

std::string Word(unsigned value)
{
    return {static_cast<char>(value), static_cast<char>(value >> 8)};
}

std::string Blocks(const std::string& bytes)
{
    std::string blocks;
    for (size_t at = 0; at < bytes.size(); at += 255)
    {
        const std::string block = bytes.substr(at, 255);
        blocks += static_cast<char>(block.size()) + block;
    }
    return blocks + '\0';
}

// Returns a palette whose entry i is (i, 2 i, 255 - i).
std::string Palette(unsigned bits)
{
    std::string colors;
    for (unsigned i = 0; i < 1u << bits; ++i)
        colors += {static_cast<char>(i), static_cast<char>(2 * i), static_cast<char>(255 - i)};
    return colors;
}

std::string Head(unsigned width, unsigned height, unsigned bits)
{
    return "GIF89a" + Word(width) + Word(height) + static_cast<char>(0x80 | (bits - 1)) +
           std::string(2, '\0') + Palette(bits);
}

std::string Image(unsigned width, unsigned height, unsigned flags, unsigned bits, const std::string& codes)
{
    return std::string(",") + Word(0) + Word(0) + Word(width) + Word(height) + static_cast<char>(flags) +
           static_cast<char>(bits) + Blocks(codes);
}

Pixels Random(size_t count, unsigned bits)
{
    std::mt19937 random(17);
    Pixels pixels(count);
    for (uint8_t& pixel : pixels)
        pixel = static_cast<uint8_t>(random() & ((1u << bits) - 1));
    return pixels;
}

// Reads the first image of a file in its own buffer, so that reading past the end is noticed.
bool ReadFirst(const std::string& file, GIFImage& image)
{
    const std::vector<char> bytes(file.begin(), file.end());
    CPicInput input(std::as_bytes(std::span(bytes)));
    CGIFReader reader(input);
    return reader.ReadHeader() && reader.ReadImage(image);
}

// A known file of 10 x 10 pixels in four colors.
const std::string
    kKnown("GIF89a\x0a\0\x0a\0\x91\0\0\xff\xff\xff\xff\0\0\0\0\xff\0\0\0!\xf9\x04\0\0\0\0\0,\0\0\0\0\x0a\0"
           "\x0a\0\0\x02\x16\x8c-\x99\x87*\x1c\xdc"
           "3\xa0\x02u\xec\x95\xfa\xa8\xde`\x8c\x04\x91L\x01\0;",
           69);

TEST(CGIFReader, ReadsAKnownFile)
{
    GIFImage image;
    ASSERT_TRUE(ReadFirst(kKnown, image));
    std::string found;
    for (const uint8_t pixel : image.pixels)
        found += static_cast<char>('0' + pixel);
    EXPECT_EQ(found, "11111222221111122222111112222211100002221110000222"
                     "22200001112220000111222221111122222111112222211111");
    EXPECT_EQ(image.palette[1], (PixelRGBA{255, 0, 0, 255}));
    EXPECT_EQ(image.palette[2], (PixelRGBA{0, 0, 255, 255}));
}

TEST(CGIFReader, ReadsCodesOfEverySize)
{
    for (unsigned bits = 1; bits <= 8; ++bits)
    {
        for (const EFull full : {EFull::Clear, EFull::Keep})
        {
            for (const Pixels& pixels : {Random(70000, bits), Random(1, bits)})
            {
                SCOPED_TRACE(std::to_string(bits) + " bits, " + std::to_string(pixels.size()));
                const unsigned width = pixels.size() == 1 ? 1 : 700;
                const auto height = static_cast<unsigned>(pixels.size()) / width;
                GIFImage image;
                ASSERT_TRUE(ReadFirst(Head(width, height, bits) +
                                          Image(width, height, 0, bits, Encoded(pixels, bits, full)),
                                      image));
                EXPECT_TRUE(image.pixels == pixels);
            }
        }
    }
}

// Runs of pixels with codes of their own, as a library writes them.
TEST(CGIFReader, PutsInterlacedRowsInOrder)
{
    for (const unsigned height : {1u, 2u, 3u, 5u, 8u, 9u, 21u})
    {
        Pixels stored;
        for (const auto& [first, step] : {std::pair(0u, 8u), {4u, 8u}, {2u, 4u}, {1u, 2u}})
        {
            for (unsigned y = first; y < height; y += step)
                stored.insert(stored.end(), 2, static_cast<uint8_t>(y));
        }
        GIFImage image;
        ASSERT_TRUE(ReadFirst(Head(2, height, 8) + Image(2, height, 0x40, 8, Encoded(stored, 8, EFull::Keep)),
                              image));
        for (unsigned y = 0; y < height; ++y)
            EXPECT_EQ(image.pixels[2 * y + 1], y) << height;
    }
}

TEST(CGIFReader, WalksTheBlocksToEachImage)
{
    const std::string comment =
        "!\xfe" + Blocks("by hand") + "!\xff" + Blocks("PROGRAM1.0") + "!\x01" + Blocks("");
    const std::string control = "!\xf9\x04\x09" + Word(0x1234) + std::string("\x03\0", 2);
    const std::string codes = Encoded({3, 2}, 2, EFull::Keep);
    const std::string ownColors = std::string(",") + Word(5) + Word(6) + Word(2) + Word(1) + "\x81" +
                                  Palette(2) + "\x02" + Blocks(codes);
    const std::string file = Head(9, 9, 8) + comment + control + Image(2, 1, 0, 2, codes) + ownColors + ";";
    CPicInput input(std::as_bytes(std::span(file)));
    CGIFReader reader(input);
    ASSERT_TRUE(reader.ReadHeader());
    EXPECT_EQ(reader.ScreenWidth(), 9);

    GIFImage image;
    ASSERT_TRUE(reader.ReadImage(image));
    EXPECT_EQ(image.delay, 0x1234);
    EXPECT_EQ(image.disposal, 2);
    EXPECT_EQ(image.palette[3], (PixelRGBA{3, 6, 252, 0})) << "transparent";
    EXPECT_EQ(image.palette[255], (PixelRGBA{255, 254, 0, 255}));
    ASSERT_TRUE(reader.ReadImage(image));
    EXPECT_EQ(image.delay, 0) << "a control extension is for one image";
    EXPECT_EQ(image.box.x, 5);
    EXPECT_EQ(image.box.y, 6);
    EXPECT_EQ(image.palette[3], (PixelRGBA{3, 6, 252, 255}));
    EXPECT_EQ(image.palette[255], (PixelRGBA{0, 0, 0, 255})) << "a table of its own, of four";
    EXPECT_FALSE(reader.ReadImage(image)) << "the trailer";
}

TEST(CGIFReader, RefusesDamage)
{
    const std::string head = Head(2, 1, 2);
    const std::string codes = Encoded({3, 2}, 2, EFull::Keep);
    const std::string image = Image(2, 1, 0, 2, codes);
    const std::tuple<const char*, std::string, bool> rows[] = {
        {"the old version", "GIF87a" + head.substr(6) + image, true},
        {"bytes behind the end code", head + Image(2, 1, 0, 2, codes + "more"), true},
        {"another name", "GIG89a" + head.substr(6) + image, false},
        {"another version", "GIF88a" + head.substr(6) + image, false},
        {"no image", head + ";", false},
        {"a block that there is not", head + "x" + image, false},
        {"a short control extension", head + "!\xf9\x02" + std::string(3, '\0') + image, false},
        {"no pixels", head + Image(0, 1, 0, 2, codes), false},
        {"more pixels than any screen", head + Image(65535, 65535, 0, 2, codes), false},
        {"pixels of no bits", head + Image(2, 1, 0, 0, codes), false},
        {"pixels of nine bits", head + Image(2, 1, 0, 9, codes), false},
        {"fewer pixels than its size", head + Image(2, 2, 0, 2, codes), false},
        // Three bits per code: clear, a pixel and an undefined code; clear and a code that is not a pixel.
        {"a code of later", head + Image(2, 1, 0, 2, std::string("\xdc\x01", 2)), false},
        {"a first code that is not a color", head + Image(2, 1, 0, 2, std::string("\x34\0", 2)), false},
    };
    for (const auto& [what, file, read] : rows)
    {
        GIFImage found;
        EXPECT_EQ(ReadFirst(file, found), read) << what;
    }
}

TEST(CGIFReader, SurvivesEveryBeginningAndEveryByte)
{
    for (size_t end = 0; end < kKnown.size(); ++end)
    {
        GIFImage image;
        EXPECT_EQ(ReadFirst(kKnown.substr(0, end), image), end + 2 >= kKnown.size()) << end;
    }
    const std::string large =
        Head(70, 60, 3) + Image(70, 60, 0x40, 3, Encoded(Random(4200, 3), 3, EFull::Clear));
    for (const std::string& good : {kKnown, large})
    {
        for (size_t at = 0; at < good.size(); ++at)
        {
            for (const int change : {0x01, 0x80, 0xff})
            {
                std::string bad = good;
                bad[at] = static_cast<char>(bad[at] ^ change);
                GIFImage image;
                const bool read = ReadFirst(bad, image);
                EXPECT_TRUE(!read || image.pixels.size() == static_cast<size_t>(image.box.width) *
                                                                static_cast<size_t>(image.box.height))
                    << at;
            }
        }
    }
}

TEST(CGIFPicture, IsADriverThatOnlyReads)
{
    const CTempFolder folder;
    const std::string path = folder.Path("a.gif");
    WriteBytes(path, kKnown);
    const PicProcs* gif = FindPictureDriver("gif");
    ASSERT_TRUE(gif);
    CPicture* const picture = gif->open(path.c_str(), "r");
    ASSERT_TRUE(picture);
    EXPECT_EQ(gif->getBox(picture).height, 10);
    uint8_t indices[3];
    ASSERT_TRUE(gif->readRow(picture, 3, 2, 3, indices));
    EXPECT_EQ(indices[0] * 100 + indices[1] * 10 + indices[2], 100);
    PixelRGBA pixels[2];
    ASSERT_TRUE(gif->readRowRGBA(picture, 9, 8, 2, pixels));
    EXPECT_EQ(pixels[1], (PixelRGBA{255, 0, 0, 255}));
    EXPECT_FALSE(gif->readRow(picture, 10, 0, 1, indices));
    EXPECT_FALSE(gif->readRowRGBA(picture, 0, 9, 2, pixels));
    EXPECT_FALSE(gif->nextPicture(picture));
    EXPECT_TRUE(gif->readRow(picture, 0, 0, 3, indices)) << "the image at hand stays";
    EXPECT_EQ(WordsOfSinglePixels(*gif, picture),
              "?gif_write_pixel\n?gif_write_pixel_rgba\n?gif_read_pixel\n?gif_read_pixel_rgba\n");
    testing::internal::CaptureStderr();
    EXPECT_FALSE(gif->open(path.c_str(), "w"));
    EXPECT_EQ(testing::internal::GetCapturedStderr(), "?GIF output not supported.\n");
    gif->close(picture);
}

} // namespace
} // namespace gw
