// `compare`: measures how faithful a result is to its source, with both read from files.

#include "BonePairs.h"
#include "CConversionPage.h"
#include "CKeyframeControl.h"
#include "CPagePart.h"
#include "CSceneFile.h"
#include "CShellConversion.h"
#include "CShellNotices.h"
#include "CheckResult.h"
#include "CommandTable.h"
#include "CompareText.h"
#include "ConvertedMotion.h"
#include "MeasureResult.h"
#include "PackagedMotion.h"
#include "PageOutput.h"
#include "Paths.h"
#include "ProfileFile.h"
#include "SystemError.h"
#include "Text.h"
#include "Words.h"

namespace gw {

namespace {

// The source as stored in its file, or as a conversion with --align reads it.
class CComparedSource
{
public:
    explicit CComparedSource(const ShellOptions& options)
        : options_(options), m_kNotices(options), m_kConversion(options, {true, false}, m_kNotices)
    {
    }

    std::string FindProfile() { return m_kConversion.ResolveProfile(options_.profile); }
    bool Load() { return options_.align ? Align() : LoadFile(); }
    MotionClip Clip();

private:
    bool Align();
    bool LoadFile();

    const ShellOptions& options_;
    CShellNotices m_kNotices;
    CShellConversion m_kConversion;
    CSceneFile m_kFile;
};

bool CComparedSource::Align()
{
    return m_kConversion.Open(options_.files[0]) && m_kConversion.SelectProfile() &&
           m_kConversion.Convert(true);
}

bool CComparedSource::LoadFile()
{
    if (!m_kFile.LoadWhole(options_.files[0]))
        return false;
    m_kFile.ShowInside(options_, options_.files[0]);
    SayWarnings(options_, options_.files[0], m_kFile.Record());
    return true;
}

// A container is animated by its first track, under its first node.
MotionClip CComparedSource::Clip()
{
    if (options_.align)
        return SourceClipOf(m_kConversion);
    if (!m_kFile.IsScene())
        return ClipOf(m_kFile.Motion());
    const std::vector<FoundNode> nodes = m_kFile.Nodes();
    const CKeyframeControl* track = m_kFile.FirstTrack();
    if (nodes.empty() || !track)
        return {};
    return {nodes.front().node, track->m_fFrequency, static_cast<int>(track->m_kKeyTimes.size())};
}

bool Pair(const ShellOptions& options, const std::string& profilePath, CNode* source, CNode* result,
          std::vector<BonePair>& pairs)
{
    std::vector<MissingBone> missing;
    if (!ReadBonePairs(profilePath, source, result, pairs, missing))
    {
        SayError(profilePath, "bad-profile", "the profile cannot be read" + TakeSystemErrorWords());
        return false;
    }
    for (const MissingBone& bone : missing)
    {
        Notice notice =
            MakeNotice(profilePath, "missing-bone",
                       std::string("the ") + (bone.side == ESkeletonSide::Source ? "source" : "result") +
                           " has no bone " + Quoted(bone.name));
        notice.where = static_cast<size_t>(bone.line);
        SayNotice(options, notice);
    }
    return missing.empty();
}

bool WriteComparison(const ShellOptions& options, const std::string& profilePath, const MotionClip& source,
                     const MotionClip& result, const MeasuredConversion& measured)
{
    ConvertedMotion motion;
    motion.source = options.files[0];
    motion.result = options.files[1];
    motion.profile = ReadProfileName(profilePath);
    motion.sourceClip = source;
    motion.resultClip = result;
    motion.measured = &measured;
    motion.model = ModelLink(options.html, motion.result);
    CPagePart part(1, 1);
    part.Show(motion);
    CConversionPage page;
    page.Add({.source = motion.source});
    page.AddDetails(part);
    return WritePage(options, page);
}

} // namespace

EExit RunCompare(const ShellOptions& options)
{
    if (const EExit page = CheckPagePath(options); page != EExit::Done)
        return page;
    if (!HasPageFolder(options))
        return EExit::Failed;
    CComparedSource source(options);
    CMotionFile result;
    const std::string profilePath = source.FindProfile();
    if (profilePath.empty() || !source.Load() || !LoadMotion(options, options.files[1], 0.0f, result))
        return EExit::Failed;
    const MotionClip sourceClip = source.Clip();
    const MotionClip resultClip = ClipOf(result);
    std::vector<BonePair> pairs;
    if (!Pair(options, profilePath, sourceClip.root, resultClip.root, pairs))
        return EExit::Failed;
    MeasuredConversion measured;
    ConversionDetail* const detail = options.html.empty() ? nullptr : &measured.detail;
    measured.sums = MeasureConversion(sourceClip, resultClip, pairs, detail);
    if (measured.sums.frameCount == 0)
    {
        SayError({}, "nothing-to-compare", "nothing to compare: one of the motions has no frames");
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
