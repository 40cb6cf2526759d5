#include "PackagedMotion.h"

#include "CCustomData.h"
#include "CMotionFile.h"
#include "COrrinStream.h"
#include "CPrivateFile.h"
#include "CSafeFile.h"
#include "PackageBlocks.h"
#include "Paths.h"
#include "Words.h"

#include <filesystem>

namespace gw {

namespace {

// Streams read files, so that the bytes inside a package have to become one for a moment.
bool LoadBytes(std::span<const std::byte> bytes, const char* extension, CMotionFile& motion)
{
    std::error_code error;
    const std::string folder = WithSeparator(std::filesystem::temp_directory_path(error).string());
    const CPrivateFile inner(folder, extension);
    CSafeFile file;
    return !inner.Path().empty() && file.Open(inner.Path()) && file.Write(bytes) && file.Commit() &&
           motion.Load(inner.Path());
}

} // namespace

bool LoadWhole(COrrinStream& scene, const std::string& path)
{
    const bool opened = scene.LoadFile(path, false);
    const CFailure& failure = scene.Record().Failure();
    if (!opened)
        SayFailure(path, failure);
    else if (failure)
        SayDamage(path, failure);
    return opened && !failure;
}

bool LoadPackagedMotion(const std::string& path, CMotionFile& motion)
{
    COrrinStream scene;
    return LoadWhole(scene, path) && LoadPackagedMotion(path, scene, motion);
}

bool LoadPackagedMotion(const std::string& path, const COrrinStream& scene, CMotionFile& motion)
{
    const CPackageBlocks blocks = FindPackage(scene);
    CPackageFacts facts;
    const bool known = blocks.file && ReadPackageFacts(*blocks.info, facts);
    if (known && LoadBytes(blocks.file->Data(), FormatExtension(facts.format), motion))
        return true;
    SayFailure(path, known ? motion.Record().Failure() : CFailure{EFailure::Empty, 0, "MotionFile"});
    return false;
}

} // namespace gw
