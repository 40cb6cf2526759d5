#include "MotionTexts.h"
#include "TKBVHStream.h"
#include "TempFolder.h"

#include <clocale>
#include <cstdlib>
#include <gtest/gtest.h>
#include <string>

namespace gw {
namespace {

// The texts written from two small motions.
std::string WrittenTexts()
{
    CLoadedMotion htr(kSmallHTR, "a.htr");
    CLoadedMotion bvh(kSmallBVH, "a.bvh");
    EXPECT_TRUE(htr.motion.Save(htr.path, 1.5f));
    EXPECT_TRUE(TKBVHStream(bvh.motion).WriteFile(bvh.path));
    return ReadBytes(htr.path) + ReadBytes(bvh.path);
}

} // namespace

TEST(CMotionFile, NoLocaleChangesAByte)
{
    const CTempFolder folder;
    const std::string make =
        "localedef -i de_DE -f UTF-8 --no-archive " + folder.Path("de_DE.UTF-8") + " >/dev/null 2>&1";
    const std::string plain = WrittenTexts();
    if (std::system(make.c_str()) != 0)
        GTEST_SKIP() << "this machine cannot make a locale";
    setenv("LOCPATH", folder.Path().c_str(), 1);
    const bool german = std::setlocale(LC_ALL, "de_DE.UTF-8") != nullptr;
    const std::string written = WrittenTexts();
    const bool comma = std::string_view(std::localeconv()->decimal_point) == ",";
    std::setlocale(LC_ALL, "C");
    unsetenv("LOCPATH");
    EXPECT_EQ(german, comma);
    EXPECT_EQ(written, plain);
}

} // namespace gw
