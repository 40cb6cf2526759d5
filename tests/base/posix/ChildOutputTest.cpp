#include "ChildOutput.h"

#include <gtest/gtest.h>
#include <string>
#include <tuple>
#include <vector>

namespace gw {
namespace {

TEST(RunChild, AProgramEndsInOneOfFiveWays)
{
    const std::tuple<const char*, const char*, EChildEnd> rows[] = {
        {"done", "printf done", EChildEnd::Finished},
        {"an exit code does not matter", "printf done; exit 3", EChildEnd::Finished},
        {"killed after it wrote", "printf done; kill -9 $$", EChildEnd::Died},
        {"hangs", "sleep 1000", EChildEnd::TimedOut},
        {"floods", "while :; do printf 0123456789; done", EChildEnd::TooMuch},
    };
    for (const auto& [what, script, end] : rows)
    {
        std::vector<std::byte> output;
        EXPECT_EQ(RunChild("/bin/sh", {"-c", script}, {.seconds = 2.0, .outputBytes = 1000}, output), end)
            << what;
        const std::string text(reinterpret_cast<const char*>(output.data()), output.size());
        EXPECT_EQ(text == "done", end == EChildEnd::Finished || end == EChildEnd::Died) << what;
    }
    std::vector<std::byte> output;
    EXPECT_EQ(RunChild("/bin/nothing-of-this-name", {}, {1.0, 1000}, output), EChildEnd::Missing);
}

} // namespace
} // namespace gw
