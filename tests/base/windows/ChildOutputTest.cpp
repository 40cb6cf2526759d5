#include "ChildOutput.h"
#include "Paths.h"

#include <gtest/gtest.h>
#include <string>
#include <tuple>
#include <vector>

namespace gw {
namespace {

// The program of the tests is the child, because an emulator's shell writes nothing without a window.
TEST(RunChild, ItsLimitsAreKept)
{
    constexpr size_t kEnough = 1 << 20;
    const std::tuple<const char*, ChildLimits, EChildEnd> rows[] = {
        {"done", {60.0, kEnough}, EChildEnd::Finished},
        {"no time", {0.0, kEnough}, EChildEnd::TimedOut},
        {"more than allowed", {60.0, 20}, EChildEnd::TooMuch},
    };
    for (const auto& [what, limits, end] : rows)
    {
        std::vector<std::byte> output;
        EXPECT_EQ(RunChild(ExecutableFolder() + "base_tests",
                           {"--gtest_list_tests", "--gtest_filter=RunChild.*"}, limits, output),
                  end)
            << what;
        const std::string text(reinterpret_cast<const char*>(output.data()), output.size());
        EXPECT_EQ(text.find("ItsLimitsAreKept\r\n") != std::string::npos, end == EChildEnd::Finished)
            << what << ": " << text;
    }
    std::vector<std::byte> output;
    EXPECT_EQ(RunChild("C:\\nothing-of-this-name", {}, {1.0, 1000}, output), EChildEnd::Missing);
}

} // namespace
} // namespace gw
