#include "CheckResult.h"

#include "CFilePlatform.h"
#include "CKeyframeControl.h"
#include "CReport.h"
#include "CShellContent.h"
#include "CShellWindow.h"
#include "ConvertFile.h"
#include "Skeleton.h"
#include "SourceTiming.h"

namespace gw {

namespace {

// What goes wrong beside a conversion that went well is nothing to tell.
class CSilentWindow : public CShellWindow
{
public:
    using CShellWindow::CShellWindow;

    EAnswer ShowMessageBox(int, const std::string&, EButtons buttons) override
    {
        return buttons == EButtons::OK ? EAnswer::OK : EAnswer::No;
    }
    void Report(const CReport&) override {}
};

// New tracks rest in the pose that the rules made of the source's rest; a saved result rests in the target's
// own, and so is it measured.
void TakeRestPose(const CMotionFile& result)
{
    for (const CNode* bone : NodesOf(*result.restRoot))
    {
        const CNode* const node = FindNode(result.motionRoot.Get(), bone->GetName());
        CKeyframeControl* const track = node ? RecordCast<CKeyframeControl>(node->GetControl()) : nullptr;
        if (track)
            track->m_kRestMatrix = bone->m_kMatrix;
    }
}

} // namespace

MotionClip SourceClipOf(const CShellContent& content)
{
    const CKeyframeControl* track = ConversionTrack(content.SourceRoot());
    if (!track)
        return {};
    return {content.DrivingRoot(), track->m_fFrequency, static_cast<int>(track->m_kKeyTimes.size())};
}

ConvertedMotion MotionOf(const CShellContent& content, const CConversionJob& job)
{
    ConvertedMotion motion;
    motion.source = job.source;
    motion.result = job.output;
    TakeRestPose(content.ResultMotion());
    motion.sourceClip = SourceClipOf(content);
    motion.resultClip = ClipOf(content.ResultMotion());
    return motion;
}

std::optional<MeasuredConversion> MeasureMotion(const ConvertedMotion& motion, const std::string& profilePath)
{
    std::vector<BonePair> pairs;
    std::vector<PairMisfit> misfits;
    if (!ReadBonePairs(profilePath, motion.sourceClip.root, motion.resultClip.root, pairs, misfits))
        return std::nullopt;
    MeasuredConversion measured;
    measured.sums = MeasureConversion(motion.sourceClip, motion.resultClip, pairs, &measured.detail);
    return measured.sums.frameCount > 0 ? std::optional(std::move(measured)) : std::nullopt;
}

std::optional<MeasuredConversion> MeasurePlainRules(const COptions& options, const CConversionJob& job,
                                                    const std::string& profilePath)
{
    if (!options.align && !options.faithful)
        return std::nullopt;
    CSilentWindow window(options);
    CFilePlatform platform(EPlatformWriting::No, options.dataFolder);
    window.SetPaths(job.source, job.output);
    CShellContent content(window, platform, EStockPick::Never);
    if (content.OpenSource() == 0 || !content.SelectProfile(profilePath) || content.ConvertMotion() == 0)
        return std::nullopt;
    return MeasureMotion(MotionOf(content, job), profilePath);
}

} // namespace gw
