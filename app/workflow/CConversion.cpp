// Converts a source to the target's motion, with the tables filled from a profile.

#include "CConversion.h"

#include "AimBones.h"
#include "AlignMotion.h"
#include "BodyOfTable.h"
#include "CKeyframeControl.h"
#include "CMapRowTable.h"
#include "CMotionFile.h"
#include "CRetargeter.h"
#include "CompleteBody.h"
#include "FindBone.h"
#include "FindingWords.h"
#include "FitWords.h"
#include "HostBones.h"
#include "Mat4.h"
#include "ProfileFit.h"
#include "Skeleton.h"
#include "TurnedBones.h"

#include <algorithm>
#include <cmath>
#include <span>

namespace gw {

namespace {

// Divides rows by their lengths and multiplies them again, because existing results were computed that way. A
// row of length 0 is not changed.
void RebuildRows(Mat4& matrix)
{
    const Vec3 lengths = RowLengths(matrix);
    const float length[] = {lengths.x, lengths.y, lengths.z};
    for (size_t row = 0; row < 3; ++row)
    {
        const std::span<float, 4> element = std::span(matrix.m).subspan(4 * row).first<4>();
        for (size_t column = 0; column < 3 && length[row] != 0.0f; ++column)
            element[column] = element[column] / length[row] * length[row];
        element[3] = 0.0f;
    }
}

// An aligned copy needs as many keys as the source's tracks contain, and a container can claim any end time
// without storing a byte for it.
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

// Returns the number of frames. If the source cannot have that many, records a failure and returns 0.
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

// Returns whether alignment corrects the problem that a reader warns about.
bool IsAligned(EFailure reason)
{
    return reason == EFailure::RestPose || reason == EFailure::DoubledOffsets;
}

} // namespace

void NotifyOfRecord(const std::string& path, const CFailureRecord& record, const ConversionChoices& choices,
                    const NoticeListener& listener)
{
    if (record.Failure())
        listener(MakeNotice(path, record.Failure()));
    for (const Finding& warning : record.Warnings())
    {
        if (!choices.align || !IsAligned(warning.reason))
            listener(MakeNotice(path, warning));
    }
}

bool CConversion::Prepare(bool doRowsFit, EAlignedJoints joints)
{
    const Finding& shares = retargeter_.Record().Failure(); // the only possible failure so far
    if (shares)
    {
        NotifyOfRecord(shares.name, retargeter_.Record(), input_.choices, notify_);
        return false;
    }
    if (!doRowsFit || !retargeter_.SourceOf(FindBone(target_.motionRoot.Get(), kRootBone)))
    {
        NotifyOfMisfit();
        return false;
    }
    if (input_.choices.align)
        return Align(joints);
    NotifyOfTurnedBones();
    return true;
}

bool CConversion::Align(EAlignedJoints joints)
{
    CNode& target = *target_.motionRoot;
    CFailureRecord record;
    BodyMotion source{input_.source, input_.timing.frequency, FramesOf(input_.timing, *input_.source, record),
                      BodyOfTable(retargeter_, CNodeNames(target))};
    NotifyOfRecord(input_.sourcePath, record, input_.choices, notify_);
    CompleteBody(source.body);
    if (input_.choices.faithful)
    {
        source.limbs = ELimbWays::Mean;
        DriveHands(retargeter_, target, source.body);
    }
    Alignment alignment;
    if (record.Failure())
        return false;
    if (!PlanAlignment(source, alignment))
    {
        notify_(MakeNotice(input_.sourcePath, {EFailure::NoBody}));
        return false;
    }
    const AlignedMotion aligned = AlignMotion(source, alignment, joints);
    AimBones(retargeter_, target, source, alignment, aligned);
    aligned_ = aligned.root;
    corrections_ = std::move(alignment.corrections);
    return true;
}

void CConversion::Run(bool useLegs, const std::function<void(size_t, size_t)>& progress)
{
    target_.quarterTurns = input_.choices.align ? EQuarterTurns::ReadBack : EQuarterTurns::Flipped;
    retargeter_.SetFaithful(input_.choices.faithful);
    retargeter_.SetHoldHands(input_.choices.holdHands);
    retargeter_.SetProgress(progress);
    retargeter_.Retarget(0.0f, input_.timing.lastFrame, 0.0f, input_.timing.frequency, kRootPosition, true,
                         useLegs);
    NotifyOfRecord(input_.sourcePath, retargeter_.Record(), input_.choices, notify_);
    NormalizeBasePose();
}

// Moves the root of the rest pose to the start of the motion's root; rotation and scale do not change.
void CConversion::NormalizeBasePose()
{
    CNode* const root = FindBone(target_.restRoot.Get(), kRootBone);
    if (!root)
        return;
    RebuildRows(root->m_kMatrix);
    root->m_kMatrix.SetTranslation(kRootPosition);
    root->m_kMatrix.m[15] = 1.0f;
}

void CConversion::NotifyOfMisfit()
{
    EFailure reason = EFailure::NoRootSource;
    if (!input_.source || !target_.motionRoot)
        reason = EFailure::NoScene;
    else if (input_.profilePath.empty())
        reason = EFailure::NoProfile;
    else if (NotifyOfMissingBones())
        return;
    else if (input_.rows.FindTarget(kRootBone) == CMapRowTable::kNone)
        reason = EFailure::NoRootRow;
    notify_(MakeNotice(input_.profilePath, {reason}));
}

// Sends notices about rows that name missing bones; returns false if there are none. Line numbers are
// included if the profile has not been edited since it was read.
bool CConversion::NotifyOfMissingBones()
{
    CNode* const target = target_.motionRoot.Get();
    CProfileFit fit;
    if (input_.areRowsEdited || !MeasureFit(input_.profilePath, input_.source, target, fit))
    {
        fit = MeasureFit(input_.rows, input_.source, target);
        fit.name = input_.profileName;
    }
    if (!fit.missing.empty())
        notify_(MisfitNotice(input_.sourcePath, fit));
    return !fit.missing.empty();
}

// Rows that rotate limbs at rest were made for a different rest pose. If the rest pose is not a T-pose, the
// file's reader has already warned about it.
void CConversion::NotifyOfTurnedBones()
{
    const auto isRestPose = [](const Finding& warning) { return warning.reason == EFailure::RestPose; };
    if (std::ranges::any_of(input_.sourceRecord.Warnings(), isRestPose))
        return;
    const std::vector<TurnedBone> bones = FindTurnedBones(retargeter_, *target_.motionRoot);
    const auto worst = std::ranges::max_element(bones, {}, &TurnedBone::degrees);
    if (worst == bones.end())
        return;
    notify_(MakeNotice(input_.sourcePath, {EFailure::TurnedAtRest, 0, worst->source, ESeverity::Warning}));
}

} // namespace gw
