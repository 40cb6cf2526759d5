#include "PackagedMotion.h"

#include "CKeyframeControl.h"
#include "CMotionFile.h"
#include "COrrinStream.h"
#include "EditMotion.h"
#include "FindingWords.h"
#include "HostBones.h"
#include "OpenSource.h"
#include "ShellOptions.h"
#include "Skeleton.h"
#include "Words.h"

#include <algorithm>
#include <cmath>
#include <vector>

namespace gw {

namespace {

constexpr int kMostPerFrame = 4; // what bone maps with the lowest rate give

// Returns whether the pose of a track at the end of the motion is the one some frames before.
bool IsRepeated(const CKeyframeControl& track, size_t framesBefore)
{
    const auto repeats = [framesBefore](const auto& keys) {
        return keys.size() <= framesBefore || keys[keys.size() - 1 - framesBefore] == keys[keys.size() - 1];
    };
    return repeats(track.m_kRotationKeys) && repeats(track.m_kPositionKeys);
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
    CSourceFile inside;
    if (!inside.OpenInside(path, scene))
        return inside.Failure();
    if (motion.Load(inside.Path()))
        return std::nullopt;
    return MakeNotice(path, motion.Record().Failure());
}

bool LoadPackagedMotion(const std::string& path, const COrrinStream& scene, CMotionFile& motion)
{
    const std::optional<Notice> failure = WhyNotUnpacked(path, scene, motion);
    if (failure)
        SayError(failure->path, failure->code.c_str(), failure->words);
    return !failure;
}

int FramesPerSourceFrame(const CMotionFile& motion)
{
    if (!motion.restRoot || motion.motionRoot->NameView() != kRootBone || motion.GetKeyCount() < 2)
        return 1;
    const std::vector<CNode*> nodes = NodesOf(*motion.motionRoot);
    int count = 1;
    while (count < kMostPerFrame && std::ranges::all_of(nodes, [count](CNode* node) {
               const auto* track = RecordCast<CKeyframeControl>(node->GetControl());
               return !track || IsRepeated(*track, static_cast<size_t>(count));
           }))
        ++count;
    return count;
}

void SayRateOfResult(const ShellOptions& options, const std::string& path, const CMotionFile& motion)
{
    const int count = FramesPerSourceFrame(motion);
    if (count == 1 || options.rate > 0.0f || !(motion.GetFrequency() > 0.0f))
        return;
    const long rate = std::lround(1.0f / motion.GetFrequency());
    SayNotice(options, MakeNotice(path, "result-rate",
                                  "the header has the source's rate, " + std::to_string(rate) +
                                      ", but the conversion wrote " + std::to_string(count) +
                                      " frames per source frame, so other programs play it slowly; --rate " +
                                      std::to_string(rate * count) + " gives the true rate",
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
