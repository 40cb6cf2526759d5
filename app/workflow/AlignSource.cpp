// The open source, told from a rest pose that suits the rules.

#include "AimBones.h"
#include "AlignMotion.h"
#include "BodyOfTable.h"
#include "CContentWindow.h"
#include "CGaitConvertContent.h"
#include "CKeyframeControl.h"
#include "CProfileEditorDialog.h"
#include "CompleteBody.h"
#include "FailureWords.h"
#include "RestMisfits.h"
#include "Skeleton.h"
#include "SourceTiming.h"
#include "TKBVHStream.h"

#include <algorithm>
#include <cmath>

namespace gw {

namespace {

// An aligned copy takes as many keys as the source's tracks hold; a container can name any end time without
// a byte behind it.
constexpr size_t kAnyKeyCount = size_t{1} << 22;

size_t KeysHeld(const std::vector<CNode*>& joints)
{
    size_t keys = 0;
    for (const CNode* joint : joints)
    {
        if (const auto* track = RecordCast<CKeyframeControl>(joint->GetControl()))
            keys += std::max(
                {track->m_kKeyTimes.size(), track->m_kRotationKeys.size(), track->m_kRotationTimes.size()});
    }
    return keys;
}

// The number of frames; 0, with the failure recorded, where they are more than the source can have.
int FramesOf(const SourceTiming& timing, CNode& root, CFailureRecord& record)
{
    const std::vector<CNode*> joints = NodesOf(root);
    const double most = static_cast<double>(std::max(KeysHeld(joints), kAnyKeyCount));
    const double frames = std::floor(static_cast<double>(timing.lastFrame)) + 1.0;
    if (frames >= 0.0 && frames * static_cast<double>(joints.size()) <= most)
        return static_cast<int>(frames);
    record.Fail(EFailure::TooLarge);
    return 0;
}

} // namespace

// Aligns the source for the rows that the retargeter was told, and lets these drive the target from the
// aligned copy: the source stays as it is. False, with the reason reported, where the rows make no body.
bool CGaitConvertContent::AlignSource(const SourceTiming& timing, EAlignedJoints joints)
{
    CNode& target = *m_kResultMotion.motionRoot;
    m_kResultStamp.reset();
    CFailureRecord record;
    BodyMotion source{SourceRoot(), timing.frequency, FramesOf(timing, *SourceRoot(), record),
                      BodyOfTable(*m_kRetargeter, CNodeNames(target))};
    Report(m_kSourcePath, record);
    CompleteBody(source.body);
    Alignment alignment;
    if (record.Failure())
        return false;
    if (!PlanAlignment(source, alignment))
    {
        m_kWindow.Report(MakeReport(m_kSourcePath, EMisfit::NoBody));
        return false;
    }
    const AlignedMotion aligned = AlignMotion(source, alignment, joints);
    AimBones(*m_kRetargeter, target, source, alignment, aligned);
    m_spkAligned = aligned.root;
    m_kAlignReport = std::move(alignment.report);
    return true;
}

// Rows that turn limbs at rest were made for another rest pose, or for none. Of a rest pose that is no
// T-pose the file's reader has warned already.
void CGaitConvertContent::ReportRestMisfits()
{
    const auto isRestPose = [](const CFailure& warning) { return warning.reason == EFailure::RestPose; };
    if (std::ranges::any_of(m_kSourceMotion.Record().Warnings(), isRestPose))
        return;
    const std::vector<RestMisfit> misfits = FindRestMisfits(*m_kRetargeter, *m_kResultMotion.motionRoot);
    const auto worst = std::ranges::max_element(misfits, {}, &RestMisfit::degrees);
    if (worst == misfits.end())
        return;
    CReport report = MakeReport(m_kSourcePath, EMisfit::TurnedAtRest, worst->source);
    report.warning = true;
    m_kWindow.Report(report);
}

bool CGaitConvertContent::WriteAligned(const std::string& path)
{
    m_kWriteRecord.Clear();
    const SourceTiming timing = ConversionTiming();
    if (!m_kResultMotion.motionRoot || !PrepareRetargeter() || !AlignSource(timing, EAlignedJoints::All))
        return false;
    TKBVHStream stream;
    stream.motionRoot = m_spkAligned;
    const bool written = stream.WriteExact(path);
    Report(path, stream.Record());
    return written;
}

} // namespace gw
