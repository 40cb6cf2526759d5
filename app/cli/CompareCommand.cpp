#include "BonePairs.h"
#include "CConversionPage.h"
#include "CFilePlatform.h"
#include "CJsonWriter.h"
#include "CKeyframeControl.h"
#include "CSceneFile.h"
#include "CShellContent.h"
#include "CShellWindow.h"
#include "Commands.h"
#include "CompareReport.h"
#include "ConvertedMotion.h"
#include "PackagedMotion.h"
#include "PageOutput.h"
#include "Paths.h"
#include "ProfileFile.h"
#include "Text.h"
#include "Words.h"

namespace gw {

namespace {

// The result of a conversion, out of its package where it lies in one.
bool LoadResult(const COptions& options, const std::string& path, CMotionFile& motion)
{
    if (HasExtension(path, ".Kinetra"))
        return LoadPackagedMotion(path, motion);
    const bool loaded = motion.Load(path);
    if (!loaded)
        SayFailure(path, motion.Record().Failure());
    SayWarnings(options, path, motion.Record());
    return loaded;
}

bool LoadSource(const COptions& options, const std::string& path, CSceneFile& file)
{
    if (!file.LoadWhole(path))
        return false;
    SayWarnings(options, path, file.Record());
    return true;
}

// A container moves by its first track, under its first node.
MotionClip SourceClip(CSceneFile& file)
{
    if (!file.IsContainer())
        return ClipOf(file.Motion());
    const std::vector<CFoundNode> nodes = file.Nodes();
    const CKeyframeControl* track = file.FirstTrack();
    if (nodes.empty() || !track)
        return {};
    return {nodes.front().node, track->m_fFrequency, static_cast<int>(track->m_kKeyTimes.size())};
}

std::string FindProfile(const COptions& options)
{
    CShellWindow window(options);
    CFilePlatform platform(EPlatformWriting::No, options.dataFolder);
    CShellContent content(window, platform);
    return content.ResolveProfile(options.profile);
}

bool Pair(const std::string& profilePath, CNode* source, CNode* result, std::vector<BonePair>& pairs)
{
    std::vector<PairMisfit> misfits;
    if (!ReadBonePairs(profilePath, source, result, pairs, misfits))
    {
        SayError(Printable(profilePath) + ": the profile cannot be read");
        return false;
    }
    for (const PairMisfit& misfit : misfits)
        SayError(Printable(profilePath) + ':' + std::to_string(misfit.line) + ": " +
                 (misfit.sourceFound ? "the result has no bone " + Quoted(misfit.target)
                                     : "the source has no bone " + Quoted(misfit.source)));
    return misfits.empty();
}

bool WriteComparison(const COptions& options, const std::string& profilePath, const MotionClip& source,
                     const MotionClip& result, const MeasuredConversion& measured)
{
    ConvertedMotion motion;
    motion.source = options.files[0];
    motion.result = options.files[1];
    motion.profile = ReadProfileName(profilePath);
    motion.sourceClip = source;
    motion.resultClip = result;
    motion.measured = &measured;
    CConversionPage page(1);
    page.Add(motion);
    return WritePage(options, page);
}

} // namespace

EExit RunCompare(const COptions& options)
{
    if (const EExit page = CheckPagePath(options); page != EExit::Done)
        return page;
    if (!HasPageFolder(options))
        return EExit::Failed;
    CSceneFile source;
    CMotionFile result;
    const std::string profilePath = FindProfile(options);
    if (profilePath.empty() || !LoadSource(options, options.files[0], source) ||
        !LoadResult(options, options.files[1], result))
        return EExit::Failed;
    const MotionClip sourceClip = SourceClip(source);
    const MotionClip resultClip = ClipOf(result);
    std::vector<BonePair> pairs;
    if (!Pair(profilePath, sourceClip.root, resultClip.root, pairs))
        return EExit::Failed;
    MeasuredConversion measured;
    ConversionDetail* const detail = options.html.empty() ? nullptr : &measured.detail;
    measured.sums = MeasureConversion(sourceClip, resultClip, pairs, detail);
    if (measured.sums.frameCount == 0)
    {
        SayError("there is nothing to compare: a motion has no frames");
        return EExit::Failed;
    }
    if (options.json)
        WriteMeasures(measured.sums);
    else
        PrintMeasures(measured.sums);
    const bool isWritten =
        options.html.empty() || WriteComparison(options, profilePath, sourceClip, resultClip, measured);
    return isWritten ? EExit::Done : EExit::Failed;
}

} // namespace gw
