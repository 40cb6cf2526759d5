#include "PackagedMotion.h"

#include "CCustomData.h"
#include "CMotionFile.h"
#include "COrrinStream.h"
#include "CPrivateFile.h"
#include "PackageBlocks.h"
#include "Paths.h"
#include "SystemError.h"
#include "Text.h"
#include "Words.h"

#include <filesystem>

namespace gw {

namespace {

bool SayNoTemporary(const std::string& folder)
{
    SayError(Printable(folder) + ": a temporary file cannot be written here" + TakeSystemErrorWords() +
             " (TMPDIR can name another folder)");
    return false;
}

// Streams read only files, so the bytes inside a package are written to a temporary file first. Returns
// false, after printing the reason, if that fails.
bool LoadBytes(const std::string& path, std::span<const std::byte> bytes, const char* extension,
               CMotionFile& motion)
{
    std::error_code error;
    const std::string folder = WithSeparator(std::filesystem::temp_directory_path(error).string());
    if (error)
        return SayNoTemporary("TMPDIR");
    CPrivateFile inner(folder, extension);
    if (!inner.Write(std::string_view(reinterpret_cast<const char*>(bytes.data()), bytes.size())))
        return SayNoTemporary(folder);
    if (motion.Load(inner.Path()))
        return true;
    SayFailure(path, motion.Record().Failure());
    return false;
}

} // namespace

bool LoadWhole(COrrinStream& scene, const std::string& path)
{
    const bool opened = scene.LoadFile(path, false);
    const Finding& failure = scene.Record().Failure();
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
    const PackageBlocks blocks = FindPackage(scene);
    PackageFacts facts;
    if (blocks.file && ReadPackageFacts(*blocks.info, facts))
        return LoadBytes(path, blocks.file->Data(), FormatExtension(facts.format), motion);
    SayFailure(path, {EFailure::Empty, 0, "MotionFile"});
    return false;
}

} // namespace gw
