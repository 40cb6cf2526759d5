// Animated pictures, from frames as libpng would write them: signature, header, pixels, end.

#include "CAnimatedPng.h"

#include <gtest/gtest.h>

namespace gw {
namespace {

// A chunk without a right checksum, which nothing reads.
std::string Chunk(const std::string& name, const std::string& content)
{
    return std::string{'\0', '\0', '\0', static_cast<char>(content.size())} + name + content + "CRC4";
}

std::string Png(const std::string& size, const std::string& pixels, const std::string& more = "")
{
    return "\x89PNG\r\n\x1a\n" + Chunk("IHDR", size + "depth") + Chunk("IDAT", pixels) +
           (more.empty() ? more : Chunk("IDAT", more)) + Chunk("IEND", "");
}

// Returns the names and contents of the chunks.
std::vector<std::pair<std::string, std::string>> ChunksOf(std::string_view file)
{
    std::vector<std::pair<std::string, std::string>> chunks;
    while (file.size() >= 12)
    {
        const auto size = static_cast<unsigned char>(file[3]);
        chunks.emplace_back(file.substr(4, 4), file.substr(8, size));
        file.remove_prefix(std::min<size_t>(file.size(), size + 12u));
    }
    return chunks;
}

} // namespace

TEST(AnimatedPng, NumbersTheChunksOfAllFrames)
{
    CAnimatedPng animation(2, 1, 30);
    const std::string first = animation.Frame(Png("WIDEHIGH", "one", "more"));
    ASSERT_TRUE(first.starts_with("\x89PNG\r\n\x1a\n"));
    const std::string file = first.substr(8) + animation.Frame(Png("WIDEHIGH", "two")) + CAnimatedPng::End();
    const auto chunks = ChunksOf(file);
    const std::string delay("\0\1\0\x1e\0\0", 6);
    const std::string zero(8, '\0');
    const std::pair<std::string, std::string> rows[] = {
        {"IHDR", "WIDEHIGHdepth"},
        {"acTL", std::string("\0\0\0\2\0\0\0\0", 8)},
        {"fcTL", std::string(4, '\0') + "WIDEHIGH" + zero + delay},
        {"IDAT", "one"},
        {"IDAT", "more"},
        {"fcTL", std::string("\0\0\0\1", 4) + "WIDEHIGH" + zero + delay},
        {"fdAT", std::string("\0\0\0\2", 4) + "two"},
        {"IEND", ""},
    };
    ASSERT_EQ(chunks.size(), std::size(rows));
    for (size_t i = 0; i < chunks.size(); ++i)
        EXPECT_EQ(chunks[i], rows[i]) << i;
    EXPECT_EQ(CAnimatedPng::End(), std::string("\0\0\0\0IEND\xae\x42\x60\x82", 12)) << "the checksum";
}

TEST(AnimatedPng, RefusesWhatIsNoFrameOfIt)
{
    const std::string whole = Png("WIDEHIGH", "one");
    for (size_t size = 0; size < whole.size() - 12; ++size) // the last chunk is not needed
        EXPECT_EQ(CAnimatedPng(1, 1, 30).Frame(whole.substr(0, size)), "") << size;
    CAnimatedPng animation(2, 1, 30);
    EXPECT_NE(animation.Frame(whole), "");
    EXPECT_EQ(animation.Frame(Png("WIDEhigh", "two")), "") << "another size";
    EXPECT_NE(animation.Frame(whole), "");
    EXPECT_EQ(animation.Frame(whole), "") << "one more than announced";
}

} // namespace gw
