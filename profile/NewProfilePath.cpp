#include "NewProfilePath.h"

#include "CProfileOwner.h"
#include "Paths.h"

namespace gw {

namespace {

constexpr int kCustomProfileCount = 9999;

} // namespace

std::string NewProfilePath(CProfileOwner& owner)
{
    std::string path;
    for (int number = 0; number < kCustomProfileCount; ++number)
    {
        path = owner.ProfileFile("Custom" + std::to_string(number) + ".prf");
        if (!FileExists(path) && !FolderExists(path))
            break;
    }
    return path;
}

} // namespace gw
