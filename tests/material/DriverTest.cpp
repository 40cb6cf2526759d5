// The table of drivers, and BMP files: every depth, both directions, files and streams, and files that are
// not BMP.

#include "CBMPPicture.h"
#include "PicFileType.h"
#include "PicProcs.h"
#include "TempFolder.h"

#include <cstdio>
#include <gtest/gtest.h>
#include <tuple>
#include <unistd.h>
#include <vector>

namespace gw {
namespace {

using namespace std::string_view_literals;

// A BMP file under construction. Rows are given as stored in the file.
struct MadeBMP
{
    int32_t width = 0;
    int32_t height = 0;
    uint16_t depth = 24;
    std::vector<uint32_t> palette;
    std::string rows;
    uint32_t compression = 0;
    uint32_t headerBytes = 40;
    uint32_t gap = 0; // before the pixels

    std::string Bytes() const
    {
        const auto paletteBytes = static_cast<uint32_t>(4 * palette.size());
        std::string bytes = "BM";
        const auto add = [&](auto value) {
            bytes.append(reinterpret_cast<const char*>(&value), sizeof value);
        };
        add(uint32_t{0});
        add(uint32_t{0});
        add(14 + headerBytes + paletteBytes + gap);
        add(headerBytes);
        add(width);
        add(height);
        add(uint16_t{1});
        add(depth);
        add(compression);
        bytes.append(20 + headerBytes - 40, '\0');
        for (const uint32_t color : palette)
            add(color);
        return bytes + std::string(gap, '\x55') + rows;
    }
};

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

// Returns all rows, one per line.
std::string RowsText(CPicture& picture)
{
    std::string text;
    for (int y = 0; y < picture.Box().height; ++y)
        text += RowText(picture, y) + "\n";
    return text;
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

// Temporarily replaces the standard input by a file or a pipe.
class StandardInput
{
public:
    StandardInput(const std::string& path, bool pipe) : m_iSaved(dup(0))
    {
        m_pkPipe = pipe ? popen(("cat '" + path + "'").c_str(), "r") : std::fopen(path.c_str(), "rb");
        dup2(fileno(m_pkPipe), 0);
        m_bPipe = pipe;
        std::clearerr(stdin);
    }
    ~StandardInput()
    {
        dup2(m_iSaved, 0);
        close(m_iSaved);
        m_bPipe ? pclose(m_pkPipe) : std::fclose(m_pkPipe);
        // Discards data that was read ahead from the old input.
        EXPECT_NE(std::freopen("/dev/null", "rb", stdin), nullptr);
    }

private:
    int m_iSaved;
    bool m_bPipe;
    std::FILE* m_pkPipe;
};

TEST_F(DriverTest, BMPReadsEveryDepth)
{
    const auto expect = [&](uint16_t depth, const std::vector<uint32_t>& palette, std::string_view row,
                            const std::string& pixels, std::string_view single) {
        SCOPED_TRACE(depth);
        const auto width = static_cast<int>(single.size());
        const auto picture = Open(MadeBMP{width, 1, depth, palette, std::string(row)}.Bytes());
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

const std::string kThreeRows("\x01\x01\x01\0\x02\x02\x02\0\x03\x03\x03\0", 12);

TEST_F(DriverTest, BMPGivesTheRowsOfAFileInItsOrder)
{
    for (const int height : {3, -3})
    {
        const auto picture = Open(MadeBMP{1, height, 24, {}, kThreeRows}.Bytes());
        ASSERT_TRUE(picture);
        EXPECT_EQ(picture->Box().height, 3);
        EXPECT_EQ(picture->IsBottomFirst(), height > 0);
        EXPECT_EQ(RowsText(*picture), "010101.ff\n020202.ff\n030303.ff\n");
        EXPECT_EQ(RowText(*picture, 1), "020202.ff");
        EXPECT_EQ(RowText(*picture, 3), "none");
        EXPECT_EQ(RowText(*picture, -1), "none");
        uint8_t pixels[2];
        EXPECT_FALSE(picture->ReadRow(0, 1, 1, pixels));
        EXPECT_FALSE(picture->ReadRow(0, -1, 1, pixels));
        EXPECT_FALSE(picture->ReadRow(0, 0, 2, pixels));
        EXPECT_FALSE(picture->WriteRow(0, 0, 1, pixels));
    }
}

TEST_F(DriverTest, BMPGivesTheRowsOfAStreamFromTheTop)
{
    // The requested rows and the results, by the number that their pixels are made of; 0 for no result.
    const std::tuple<const char*, int, bool, std::string_view, std::string_view> cases[] = {
        {"a file, bottom up", 3, false, "012", "321"},  {"a file, top down", -3, false, "012", "123"},
        {"a file, back again", -3, false, "20", "31"},  {"a pipe, top down", -3, true, "02", "13"},
        {"a pipe, bottom up", 3, true, "210", "123"},   {"a pipe, and back", -3, true, "101", "202"},
        {"a pipe, in pieces", 3, true, "2200", "1133"},
    };
    for (const auto& [what, height, pipe, order, rows] : cases)
    {
        SCOPED_TRACE(what);
        WriteBytes(Path(), MadeBMP{1, height, 24, {}, kThreeRows, 0, 40, 5}.Bytes());
        const StandardInput input(Path(), pipe);
        const auto picture = OpenPicture("-.bmp", "r");
        ASSERT_TRUE(picture);
        EXPECT_FALSE(picture->IsBottomFirst());
        std::string found;
        for (const char y : order)
        {
            PixelRGBA pixel{};
            picture->ReadRowRGBA(y - '0', 0, 1, &pixel);
            found += static_cast<char>('0' + pixel.g);
        }
        EXPECT_EQ(found, rows);
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

// Tries every prefix of a file, and every byte of its header at its extremes, under the sanitizers.
TEST_F(DriverTest, BMPSurvivesDamage)
{
    testing::internal::CaptureStderr();
    const auto readRows = [&](const std::string& bytes) {
        const auto picture = Open(bytes);
        for (int y = 0; picture && y < std::min(3, picture->Box().height); ++y)
            RowText(*picture, y);
        return picture != nullptr;
    };
    for (const auto& [depth, height] : {std::pair<uint16_t, int>(1, 2), {4, -2}, {24, 2}, {32, -2}})
    {
        const size_t colors = depth < 16 ? size_t{1} << depth : 0;
        const std::string good = MadeBMP{3, height, depth, Colors(colors), std::string(24, 'x')}.Bytes();
        for (size_t end = 0; end < good.size(); ++end)
            EXPECT_LE(readRows(good.substr(0, end)), end > 54 + 4 * colors) << end;
        for (size_t at = 10; at < 54; ++at)
        {
            for (const char value : {'\0', '\x7f', '\x80', '\xff'})
                readRows(std::string(good).replace(at, 1, 1, value));
        }
    }
    testing::internal::GetCapturedStderr();
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

TEST_F(DriverTest, BMPOfOneChannelComesBackInGrey)
{
    auto picture = OpenPicture(Path(), "w");
    ASSERT_TRUE(picture);
    EXPECT_FALSE(picture->SetChannelCount(2));
    ASSERT_TRUE(picture->SetChannelCount(1));
    ASSERT_TRUE(picture->SetSize({0, 0, 3, 1}));
    const PixelRGBA pixels[] = {{0, 0, 0, 9}, {255, 255, 255, 0}, {100, 100, 100, 0}};
    ASSERT_TRUE(picture->WriteRowRGBA(0, 0, 3, pixels));
    EXPECT_TRUE(picture->Close());
    picture = OpenPicture(Path(), "r");
    ASSERT_TRUE(picture);
    EXPECT_EQ(RowsText(*picture), "000000.ff ffffff.ff 646464.ff\n");
}

TEST_F(DriverTest, BMPTellsThatRowsAreMissing)
{
    auto picture = OpenPicture(Path(), "w");
    ASSERT_TRUE(picture && picture->SetSize({0, 0, 1, 2}));
    const uint8_t grey[] = {9};
    ASSERT_TRUE(picture->WriteRow(0, 0, 1, grey));
    EXPECT_FALSE(picture->Close());
    EXPECT_EQ(ReadBytes(Path()).size(), 58u) << "what was written stays";
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
    testing::internal::CaptureStderr();
    bmp->clear(picture, 1);
    bmp->clearRGBA(picture, {});
    bmp->writePixel(picture, 0, 0, 1);
    bmp->writePixelRGBA(picture, 0, 0, {});
    EXPECT_EQ(bmp->readPixel(picture, 0, 0), 0);
    EXPECT_EQ(bmp->readPixelRGBA(picture, 0, 0), PixelRGBA{});
    EXPECT_EQ(testing::internal::GetCapturedStderr(),
              "?picbmp_write_pixel\n?picbmp_write_pixel_rgba\n?picbmp_read_pixel\n?picbmp_read_pixel_rgba\n");
    EXPECT_EQ(bmp->getName(picture), Path());
    EXPECT_FALSE(bmp->nextPicture(picture));
    PixelRGBA pixel{};
    EXPECT_TRUE(bmp->readRowRGBA(picture, 0, 0, 1, &pixel));
    EXPECT_EQ(pixel, (PixelRGBA{'3', '2', '1', 255}));
    EXPECT_TRUE(bmp->close(picture));
}

TEST_F(DriverTest, KnowsFileTypesByNameAndBytes)
{
    std::string drivers;
    for (const PicProcs& driver : PictureDrivers())
        drivers.append(driver.name).append(" ");
    EXPECT_EQ(drivers, "bmp gif ");

    const std::tuple<const char*, std::string_view> names[] = {
        {"a.bmp", "bmp"},  {"-.bmp", "bmp"}, {"a.b.GIF", "gif"}, {"a.PJpeg", "jpg"},
        {"a.tiff", "tif"}, {"a.ppm", "pnm"}, {"a.Z", "rle"},     {"a", "none"},
        {"a.", "none"},    {"bmp", "none"},  {"a.txt", "none"},
    };
    for (const auto& [name, wanted] : names)
    {
        const PicFileType* type = FindPictureType(name);
        EXPECT_EQ(type ? type->driver : "none", wanted) << name;
    }
    EXPECT_EQ(FindPictureType("a.Z")->magic, 0x1f9d);
    EXPECT_EQ(FindPictureType("a.z")->magic, 0x1f8b);

    const std::tuple<std::string_view, const char*> heads[] = {
        {"BM123", "bmp"},  {"\x50\x88", "dump"}, {"-\xcc\x52", "rle"},
        {"\x1f\x8b", "z"}, {"\xcc\x52-", ""},    {"B", ""},
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
