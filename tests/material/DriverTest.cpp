// The table of drivers, and BMP files: every depth, both directions, files and streams, and files that are
// not BMP.

#include "DriverSamples.h"
#include "PicFileType.h"
#include "TempFolder.h"

#include <cstdio>
#include <gtest/gtest.h>
#include <tuple>
#include <vector>

namespace gw {
namespace {

using namespace std::string_view_literals;

// Colors as stored: blue in the lowest byte.
const std::vector<uint32_t> kTwoColors = {0x00112233, 0x00aabbcc};

std::vector<uint32_t> Colors(size_t count)
{
    std::vector<uint32_t> colors;
    for (size_t i = 0; i < count; ++i)
        colors.push_back(static_cast<uint32_t>(i) * 0x010203);
    return colors;
}

std::string Text(const std::vector<PixelRGBA>& pixels)
{
    std::string text;
    for (const PixelRGBA& pixel : pixels)
    {
        char word[16];
        std::snprintf(word, sizeof word, "%s%02x%02x%02x.%02x", text.empty() ? "" : " ", pixel.r, pixel.g,
                      pixel.b, pixel.a);
        text += word;
    }
    return text;
}

// Returns a row of a picture as text, "none" if it cannot be read.
std::string RowText(CPicture& picture, int y)
{
    std::vector<PixelRGBA> pixels(static_cast<size_t>(picture.Box().width));
    return picture.ReadRowRGBA(y, 0, picture.Box().width, pixels.data()) ? Text(pixels) : "none";
}

class DriverTest : public testing::Test
{
protected:
    std::unique_ptr<CPicture> Open(const std::string& bytes, const char* name = "a.bmp")
    {
        WriteBytes(m_kFolder.Path(name), bytes);
        return OpenPicture(m_kFolder.Path(name), "r");
    }
    std::string Path(const char* name = "a.bmp") const { return m_kFolder.Path(name); }

    CTempFolder m_kFolder;
};

TEST_F(DriverTest, BMPReadsEveryDepth)
{
    const auto expect = [&](uint16_t depth, const std::vector<uint32_t>& palette, std::string_view row,
                            const std::string& pixels, std::string_view single) {
        SCOPED_TRACE(depth);
        const auto width = static_cast<int>(single.size());
        const std::string bytes = MadeBMP{width, 1, depth, palette, std::string(row)}.Bytes();
        testing::internal::CaptureStderr();
        for (size_t end = 0; end < bytes.size(); ++end)
        {
            if (const auto cut = Open(bytes.substr(0, end))) // does no harm
                RowText(*cut, 0);
        }
        testing::internal::GetCapturedStderr();
        const auto picture = Open(bytes);
        ASSERT_TRUE(picture);
        EXPECT_EQ(picture->ChannelCount(), 3);
        EXPECT_EQ(picture->Box().width, width);
        EXPECT_EQ(RowText(*picture, 0), pixels);
        std::string found(single.size(), '\0');
        ASSERT_TRUE(picture->ReadRow(0, 0, width, reinterpret_cast<uint8_t*>(found.data())));
        EXPECT_EQ(found, single);
        PixelRGBA last{};
        ASSERT_TRUE(picture->ReadRowRGBA(0, width - 1, 1, &last));
        EXPECT_TRUE(pixels.ends_with(Text({last})));
    };
    expect(1, kTwoColors, "\xa0\x80\0\0"sv,
           "aabbcc.ff 112233.ff aabbcc.ff 112233.ff 112233.ff 112233.ff 112233.ff 112233.ff aabbcc.ff",
           "\1\0\1\0\0\0\0\0\1"sv);
    expect(2, Colors(4), "\x1b\xc0\0\0"sv, "000000.ff 010203.ff 020406.ff 030609.ff 030609.ff",
           "\0\1\2\3\3"sv);
    expect(4, Colors(16), "\x2f\x10\0\0"sv, "020406.ff 0f1e2d.ff 010203.ff", "\2\xf\1"sv);
    expect(8, Colors(256), "\x03\x4f\0\0"sv, "030609.ff 4f9eed.ff", "\3\x4f"sv);
    expect(16, {}, "\x00\x7c\xe0\x03\x1f\x80\0\0"sv, "ff0000.ff 00ff00.ff 0000ff.ff", "\x4c\x95\x1c"sv);
    expect(16, {}, "\x21\x04\0\0"sv, "080808.ff", "\x8"sv);
    expect(24, {}, "\x01\x02\x03\0"sv, "030201.ff", "\2"sv);
    expect(24, {}, "\x01\x02\x03\xff\xfe\xfd\0\0"sv, "030201.ff fdfeff.ff", "\2\xfd"sv);
    expect(32, {}, "\x01\x02\x03\x04\xff\xfe\xfd\0"sv, "030201.04 fdfeff.00", "\2\xfd"sv);
}

TEST_F(DriverTest, BMPGivesTheRowsOfAFileInItsOrder)
{
    for (const int height : {3, -3})
    {
        const auto picture = Open(MadeBMP{1, height, 24, {}, kThreeRows}.Bytes());
        ASSERT_TRUE(picture);
        EXPECT_EQ(picture->Box().height, 3);
        EXPECT_EQ(picture->IsBottomFirst(), height > 0);
        EXPECT_EQ(RowText(*picture, 2), "030303.ff");
        EXPECT_EQ(RowText(*picture, 0), "010101.ff");
        EXPECT_EQ(RowText(*picture, 3), "none");
        EXPECT_EQ(RowText(*picture, -1), "none");
        uint8_t pixels[2];
        EXPECT_FALSE(picture->ReadRow(0, 1, 1, pixels));
        EXPECT_FALSE(picture->ReadRow(0, -1, 1, pixels));
        EXPECT_FALSE(picture->ReadRow(0, 0, 2, pixels));
        EXPECT_FALSE(picture->WriteRow(0, 0, 1, pixels));
    }
}

TEST_F(DriverTest, BMPFindsItsPixels)
{
    const auto expect = [&](const char* what, const MadeBMP& made, const char* pixels) {
        SCOPED_TRACE(what);
        const auto picture = Open(made.Bytes());
        ASSERT_TRUE(picture);
        EXPECT_EQ(RowText(*picture, 0), pixels);
    };
    const std::string color("\x01\x02\x03\0", 4);
    const std::string indices("\x02\x03\0\0", 4);
    expect("behind a gap", {1, 1, 24, {}, color, 0, 40, 10}, "030201.ff");
    expect("behind a larger header", {1, 1, 24, {}, color, 0, 124}, "030201.ff");
    expect("behind few colours", {2, 1, 8, Colors(3), indices}, "020406.ff 000000.ff");
    expect("behind no colours", {2, 1, 4, {}, indices}, "000000.ff 222222.ff");

    std::string noOffset = MadeBMP{2, 1, 8, Colors(256), indices}.Bytes();
    noOffset.replace(10, 4, 4, '\0');
    EXPECT_EQ(RowText(*Open(noOffset), 0), "020406.ff 030609.ff") << "where the palette ends";
}

TEST_F(DriverTest, BMPRefusesInItsOwnWords)
{
    const auto expect = [&](const char* what, const std::string& bytes, const std::string& reason) {
        WriteBytes(Path(), bytes);
        testing::internal::CaptureStderr();
        EXPECT_FALSE(OpenPicture(Path(), "r")) << what;
        const std::string words = reason.empty() ? "" : Path() + reason + "\n";
        EXPECT_EQ(testing::internal::GetCapturedStderr(), words + Path() + ": read header failed.\n") << what;
    };
    const auto made = [](int width, int height, uint16_t depth, uint32_t compression = 0) {
        return MadeBMP{width, height, depth, {}, "1234", compression}.Bytes();
    };
    const std::string good = made(1, 1, 24);
    expect("no bytes", "", "");
    expect("another file", "MB" + good.substr(2), " doesn't begin with 'BM'.");
    expect("a compressed one", made(1, 1, 8, 1), " is compressed; only BI_RGB supported.");
    expect("a depth of 3", made(1, 1, 3), " has unsupported bit depth 3");
    expect("a depth of 0", made(1, 1, 0), " has unsupported bit depth 0");
    expect("no width", made(0, 1, 24), "");
    expect("a negative width", made(-1, 1, 24), "");
    expect("no height", made(1, 0, 24), "");
    expect("the least height", made(1, INT32_MIN, 24), "");
    expect("rows beyond the end", made(1, 2, 24), "");
    expect("rows beyond any memory", made(INT32_MAX, INT32_MAX, 32), "");
    expect("a row beyond any memory", made(INT32_MAX, -1, 32), "");
    expect("a palette that is cut", MadeBMP{1, 1, 8, Colors(256), ""}.Bytes().substr(0, 500), "");
    expect("an older header", good.substr(0, 14) + '\x0c' + good.substr(15), "");
}

TEST_F(DriverTest, BMPIsWrittenTopDown)
{
    auto picture = OpenPicture(Path(), "w");
    ASSERT_TRUE(picture);
    const PixelRGBA pixels[] = {{1, 2, 3, 4}, {5, 6, 7, 8}};
    EXPECT_FALSE(picture->WriteRowRGBA(0, 0, 2, pixels)) << "no size yet";
    ASSERT_TRUE(picture->SetSize({0, 0, 2, 2}));
    ASSERT_TRUE(picture->WriteRowRGBA(0, 0, 2, pixels));
    EXPECT_FALSE(picture->SetSize({0, 0, 3, 3})) << "rows have come";
    EXPECT_FALSE(picture->WriteRowRGBA(0, 0, 2, pixels)) << "rows come in order";
    EXPECT_FALSE(picture->WriteRowRGBA(1, 1, 2, pixels)) << "beyond the edge";
    const uint8_t grey[] = {9};
    ASSERT_TRUE(picture->WriteRow(1, 1, 1, grey));
    EXPECT_TRUE(picture->Close());

    std::string expected =
        MadeBMP{2, -2, 24, {}, std::string("\3\2\1\7\6\5\0\0\0\0\0\t\t\t\0\0", 16)}.Bytes();
    expected[2] = 70; // the file's size
    EXPECT_EQ(ReadBytes(Path()), expected);
}

TEST_F(DriverTest, BMPOfOneChannelIsGreyAndTellsThatRowsAreMissing)
{
    auto picture = OpenPicture(Path(), "w");
    ASSERT_TRUE(picture);
    EXPECT_FALSE(picture->SetChannelCount(2));
    ASSERT_TRUE(picture->SetChannelCount(1) && picture->SetSize({0, 0, 1, 2}));
    const PixelRGBA red{255, 0, 0, 9};
    ASSERT_TRUE(picture->WriteRowRGBA(0, 0, 1, &red));
    EXPECT_FALSE(picture->Close());
    EXPECT_EQ(ReadBytes(Path())[28], 8) << "bits of a pixel";
    EXPECT_EQ(ReadBytes(Path()).substr(54), std::string("\x4c\0\0\0", 4)) << "what was written stays";
    EXPECT_EQ(RowText(*Open(MadeBMP{2, 1, 8, {}, "\x4c\xff\x01\x01"}.Bytes()), 0), "4c4c4c.ff ffffff.ff");
    EXPECT_FALSE(OpenPicture(Path("none/a.bmp"), "w"));
    EXPECT_FALSE(OpenPicture(Path(), "x"));
}

TEST_F(DriverTest, SinglePixelsAreNotSupported)
{
    WriteBytes(Path(), MadeBMP{1, 1, 24, {}, "1234"}.Bytes());
    const PicProcs* bmp = FindPictureDriver("bmp");
    ASSERT_TRUE(bmp);
    CPicture* const picture = bmp->open(Path().c_str(), "r");
    ASSERT_TRUE(picture);
    EXPECT_EQ(WordsOfSinglePixels(*bmp, picture),
              "?picbmp_write_pixel\n?picbmp_write_pixel_rgba\n?picbmp_read_pixel\n?picbmp_read_pixel_rgba\n");
    EXPECT_EQ(bmp->getName(picture), Path());
    EXPECT_FALSE(bmp->nextPicture(picture));
    EXPECT_TRUE(bmp->close(picture));
}

TEST_F(DriverTest, KnowsFileTypesByNameAndBytes)
{
    std::string drivers;
    for (const PicProcs& driver : PictureDrivers())
        drivers.append(driver.name).append(" ");
    EXPECT_EQ(drivers, "bmp gif ");

    const std::pair<const char*, std::string_view> names[] = {
        {"-.bmp", "bmp"}, {"a.b.GIF", "gif"}, {"a.PJpeg", "jpg"}, {"a.ppm", "pnm"},
        {"a.Z", "rle"},   {"a.", "none"},     {"bmp", "none"},
    };
    for (const auto& [name, wanted] : names)
    {
        const PicFileType* type = FindPictureType(name);
        EXPECT_EQ(type ? type->driver : "none", wanted) << name;
    }
    EXPECT_EQ(FindPictureType("a.Z")->magic, 0x1f9d);
    EXPECT_EQ(FindPictureType("a.z")->magic, 0x1f8b);

    const std::pair<std::string_view, const char*> heads[] = {
        {"BM123", "bmp"},
        {"-\xcc\x52", "rle"},
        {"\xcc\x52-", ""},
        {"B", ""},
    };
    for (const auto& [bytes, extension] : heads)
    {
        const PicFileType* type = FindPictureTypeOfBytes(std::as_bytes(std::span(bytes)));
        EXPECT_EQ(type ? type->extension : "", extension);
    }
    EXPECT_TRUE(Open(MadeBMP{1, 1, 24, {}, "1234"}.Bytes(), "a.picture")) << "by its first bytes";
    EXPECT_FALSE(Open("P6 1 1 255 abc", "a.ppm")) << "a type without a driver";
}

} // namespace
} // namespace gw
