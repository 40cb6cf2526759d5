#include "CheckResult.h"

#include "CShellConversion.h"
#include "ConvertFile.h"
#include "HTRPose.h"
#include "MeasureResult.h"
#include "NativePath.h"
#include "Paths.h"
#include "ShellOptions.h"

#include <algorithm>
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
    const auto full = [&](const std::string& path) {
        return std::filesystem::absolute(NativePath(path), error).lexically_normal();
    };
    const std::filesystem::path folder = full(page).parent_path();
    std::string link = PathText(full(result).lexically_relative(folder));
    std::ranges::replace(link, kPathSeparator, '/'); // as links have it on every system
    std::string beside = SplitPath(result).stem + ".glb";
    if (HasExtension(result, ".glb") && !link.starts_with(".."))
        return link;
    return FileExists(PathText(folder / NativePath(beside))) ? beside : std::string();
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
