#include "PackagedMotion.h"

#include "CCustomData.h"
#include "CMotionFile.h"
#include "COrrinStream.h"
#include "CPrivateFile.h"
#include "CSourceFile.h"
#include "EditMotion.h"
#include "FindingWords.h"
#include "HostBones.h"
#include "PackageBlocks.h"
#include "Paths.h"
#include "ShellOptions.h"
#include "SystemError.h"
#include "Text.h"
#include "Words.h"

#include <cmath>

namespace gw {

namespace {

// Streams read only files, so the bytes inside a package are written to a temporary file first.
std::optional<Notice> WhyNotLoaded(const std::string& path, std::span<const std::byte> bytes,
                                   const char* extension, CMotionFile& motion)
{
    CPrivateFile inner;
    if (!inner.CreateTemporary(extension) ||
        !inner.Write(std::string_view(reinterpret_cast<const char*>(bytes.data()), bytes.size())))
        return MakeNotice(path, "no-temporary-file",
                          "a temporary file cannot be written" + TakeSystemErrorWords() +
                              " (TMPDIR can name another folder)");
    if (motion.Load(inner.Path()))
        return std::nullopt;
    return MakeNotice(path, motion.Record().Failure());
}

} // namespace

bool LoadWhole(COrrinStream& scene, const std::string& path, const std::string& shownPath)
{
    const bool opened = scene.LoadFile(path, false);
    const Finding& failure = scene.Record().Failure();
    if (!opened)
        SayFailure(shownPath, failure);
    else if (failure)
        SayDamage(shownPath, failure);
    return opened && !failure;
}

std::optional<Notice> WhyNotUnpacked(const std::string& path, const COrrinStream& scene, CMotionFile& motion)
{
    const PackageBlocks blocks = FindPackage(scene);
    PackageFacts facts;
    if (blocks.file && ReadPackageFacts(*blocks.info, facts))
        return WhyNotLoaded(path, blocks.file->Data(), FormatExtension(facts.format), motion);
    return MakeNotice(path, {EFailure::Empty, 0, "MotionFile"});
}

bool LoadPackagedMotion(const std::string& path, const COrrinStream& scene, CMotionFile& motion)
{
    const std::optional<Notice> failure = WhyNotUnpacked(path, scene, motion);
    if (failure)
        SayError(failure->path, failure->code.c_str(), failure->words);
    return !failure;
}

void SayRateOfResult(const ShellOptions& options, const std::string& path, const CMotionFile& motion)
{
    const float rate = motion.GetFrequency() > 0.0f ? 1.0f / motion.GetFrequency() : 0.0f;
    const bool isResult = motion.restRoot && motion.motionRoot->NameView() == kRootBone;
    if (!isResult || options.rate > 0.0f || motion.GetKeyCount() < 2)
        return;
    SayNotice(
        options,
        MakeNotice(path, "result-rate",
                   "the header has the source's rate, " + std::to_string(std::lround(rate)) +
                       ", but a conversion writes several frames per source frame (4 if the bone map's rate "
                       "is 30), so other programs play it slowly; --rate R gives the true rate",
                   ESeverity::Warning));
}

bool LoadMotion(const ShellOptions& options, const std::string& path, float rate, CMotionFile& motion)
{
    CSourceFile source;
    if (!OpenSource(source, path, EPackage::Unpacked))
        return false;
    motion.importChoice = {options.clip, rate};
    const bool isLoaded = motion.Load(source.Path());
    if (!isLoaded)
        SayFailure(path, motion.Record().Failure());
    SayWarnings(options, path, motion.Record());
    if (isLoaded && rate > 0.0f)
        SetFrameTime(*motion.motionRoot, 1.0f / rate);
    return isLoaded;
}

} // namespace gw
