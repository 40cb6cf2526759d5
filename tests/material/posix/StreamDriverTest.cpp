#include "CPicture.h"
#include "DriverSamples.h"
#include "TempFolder.h"

#include <cstdio>
#include <fcntl.h>
#include <gtest/gtest.h>
#include <string>
#include <tuple>
#include <unistd.h>

namespace gw {
namespace {

// Temporarily replaces the standard input by a file or by a pipe with its bytes.
class StandardInput
{
public:
    StandardInput(const std::string& path, bool piped) : m_iSaved(dup(0))
    {
        int ends[2] = {open(path.c_str(), O_RDONLY), -1};
        if (piped)
        {
            const std::string bytes = ReadBytes(path); // few enough for a pipe to hold
            close(ends[0]);
            EXPECT_EQ(pipe(ends), 0);
            EXPECT_EQ(write(ends[1], bytes.data(), bytes.size()), static_cast<ssize_t>(bytes.size()));
            close(ends[1]);
        }
        dup2(ends[0], 0);
        close(ends[0]);
        std::clearerr(stdin);
    }
    ~StandardInput()
    {
        dup2(m_iSaved, 0);
        close(m_iSaved);
        // Discards data that was read ahead from the old input.
        EXPECT_NE(std::freopen("/dev/null", "rb", stdin), nullptr);
    }

private:
    int m_iSaved;
};

} // namespace

TEST(StreamDriver, BMPGivesTheRowsOfAStreamFromTheTop)
{
    const CTempFolder folder;
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
        const std::string path = folder.Path("a.bmp");
        WriteBytes(path, MadeBMP{1, height, 24, {}, kThreeRows, 0, 40, 5}.Bytes());
        const StandardInput input(path, pipe);
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

} // namespace gw
