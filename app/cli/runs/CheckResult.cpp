#include "CheckResult.h"

#include "CShellConversion.h"
#include "ConvertFile.h"
#include "HTRPose.h"
#include "MeasureResult.h"
#include "NativePath.h"
#include "Paths.h"
#include "ShellOptions.h"

#include <filesystem>

namespace gw {

ConvertedMotion MotionOf(const CFileConversion& conversion, const ConversionJob& job)
{
    ConvertedMotion motion;
    motion.source = job.source;
    motion.result = job.output;
    TakeWrittenPoses(conversion.Result());
    motion.sourceClip = SourceClipOf(conversion);
    motion.resultClip = ClipOf(conversion.Result());
    return motion;
}

std::string ModelLink(const std::string& page, const std::string& result)
{
    std::error_code error;
    const std::filesystem::path folder =
        std::filesystem::absolute(NativePath(page), error).lexically_normal().parent_path();
    std::string link = std::filesystem::absolute(NativePath(result), error)
                           .lexically_normal()
                           .lexically_relative(folder)
                           .generic_string();
    std::string beside = SplitPath(result).stem + ".glb";
    if (HasExtension(result, ".glb") && !link.starts_with(".."))
        return link;
    return FileExists(PathText(folder / beside)) ? beside : std::string();
}

std::optional<MeasuredConversion> MeasureMotion(const ConvertedMotion& motion, const std::string& profilePath)
{
    std::vector<BonePair> pairs;
    std::vector<MissingBone> missing;
    if (!ReadBonePairs(profilePath, motion.sourceClip.root, motion.resultClip.root, pairs, missing))
        return std::nullopt;
    return MeasureResult(motion.sourceClip, motion.resultClip, pairs);
}

ConversionChoices ChoicesOf(const ShellOptions& options)
{
    return {options.align, options.faithful, !options.noHands};
}

std::optional<MeasuredConversion> MeasureAnew(const ShellOptions& options, const ConversionChoices& choices,
                                              const ConversionJob& job, const CShellConversion& done)
{
    CFileConversion conversion(options.dataFolder, choices, [](const Notice&) {});
    conversion.SelectSource(options.clip, options.rate);
    if (!conversion.LoadSource(job.source, done.ReadPath()) || !conversion.LoadTarget())
        return std::nullopt;
    conversion.UseProfile(done.ProfilePath(), done.Profile());
    if (!conversion.Convert(!options.noLegs))
        return std::nullopt;
    return MeasureMotion(MotionOf(conversion, job), done.ProfilePath());
}

} // namespace gw
