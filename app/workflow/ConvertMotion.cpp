// From the open source and the profile to the target's motion.

#include "AlignMotion.h"
#include "CContentWindow.h"
#include "CGaitConvertContent.h"
#include "CProfileEditorDialog.h"
#include "CWaitCursor.h"
#include "FailureWords.h"
#include "FindBone.h"
#include "FitWords.h"
#include "HostBones.h"
#include "Mat4.h"
#include "ProfileFit.h"
#include "SourceTiming.h"
#include "StringTable.h"

#include <span>

namespace gw {

namespace {

// Rows divided by their lengths and multiplied by them again, as results have always been made; a row of
// length 0 is left alone.
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

} // namespace

int CGaitConvertContent::ConvertMotion()
{
    const CWaitCursor wait(m_kWindow);
    ForgetFailedSave();
    ForViews(&CMotionView::Stop);
    ReloadResult();
    if (m_pkProfile)
        m_pkProfile->SetResultScene(m_kResultMotion.motionRoot.Get());
    const SourceTiming timing = ConversionTiming();
    if (!PrepareRetargeter() || !PrepareSource(timing))
    {
        ShowMessage(kCannotConvertMessage, EButtons::OK);
        return 0;
    }
    const bool useLegs = !m_kWindow.IsKeyDown(EKey::LeftShift);
    Retarget(timing, useLegs);
    if (m_pkSourceView)
        m_pkSourceView->Seek(0, kScrollRange);
    m_bConverted = true;
    UpdateControls();
    return 1;
}

// The stamp is taken first: a change during the reading makes the next conversion read again.
void CGaitConvertContent::LoadResult()
{
    const std::optional<FileStamp> stamp = StampOf(BaseFile());
    m_kResultStamp = m_kResultMotion.Load(BaseFile()) ? stamp : std::nullopt;
}

// Every conversion starts with the skeleton as its file has it now. The first one after an open need not read
// the file again, unless it has changed since.
void CGaitConvertContent::ReloadResult()
{
    if (!m_kResultStamp || m_kResultStamp != StampOf(BaseFile()))
        LoadResult();
    Report(BaseFile(), m_kResultMotion.Record());
}

// Fills a retargeter's tables from the profile. It is a new one: tables are keyed by the target's bones, and
// a bone of a target that is gone may lie where one of the present target lies now. False, with the reason
// reported, when they cannot drive a conversion.
bool CGaitConvertContent::PrepareRetargeter()
{
    CRetargeter& retargeter = m_kRetargeter.emplace();
    const bool ready = m_pkProfile && m_pkProfile->ApplyProfile(&retargeter, nullptr, nullptr) &&
                       m_pkProfile->HasRootMapping() &&
                       retargeter.SourceOf(FindBone(m_kResultMotion.motionRoot.Get(), kRootBone));
    const CFailure& shares = retargeter.Record().Failure(); // all that can have failed up to here
    if (shares)
    {
        Report(shares.name, retargeter.Record());
        return false;
    }
    if (!ready)
        ReportMisfit();
    return ready;
}

SourceTiming CGaitConvertContent::ConversionTiming() const
{
    return m_bSourceIsContainer ? TimingOf(ConversionTrack(SourceRoot())) : TimingOf(m_kSourceMotion);
}

// The aligned copy of a conversion before is of no use any more, be it of the same source.
bool CGaitConvertContent::PrepareSource(const SourceTiming& timing)
{
    m_spkAligned = nullptr;
    if (m_kChoices.align)
        return AlignSource(timing, EAlignedJoints::Body);
    ReportRestMisfits();
    return true;
}

void CGaitConvertContent::Retarget(const SourceTiming& timing, bool useLegs)
{
    m_kResultStamp.reset();
    m_kRetargeter->SetFaithful(m_kChoices.faithful);
    m_kRetargeter->SetProgress([this](size_t done, size_t total) { ShowProgress(done, total); });
    m_kRetargeter->Retarget(0.0f, timing.lastFrame, 0.0f, timing.frequency, kRootPosition, true, useLegs);
    Report(m_kSourcePath, m_kRetargeter->Record());
    const SourceTiming result = TimingOf(m_kResultMotion);
    if (m_pkResultView)
        m_pkResultView->SetScene(m_kResultMotion.motionRoot.Get(), result.FrameStep(), result.lastFrame);
    NormalizeBasePose();
    ShowTitle(m_kTitle);
}

void CGaitConvertContent::ShowProgress(size_t done, size_t total)
{
    if (!m_kWindow.IsProgressDue())
        return;
    const std::string percent = std::to_string(100 * done / total) + " %";
    ShowTitle(m_kTitle.empty() ? "Converting " + percent : m_kTitle + ", " + percent);
    m_kWindow.StayPainted();
}

// Puts the rest pose's root where the motion's root begins; rotation and scale stay.
void CGaitConvertContent::NormalizeBasePose()
{
    CNode* const root = FindBone(m_kResultMotion.restRoot.Get(), kRootBone);
    if (!root)
        return;
    RebuildRows(root->m_kMatrix);
    root->m_kMatrix.SetTranslation(kRootPosition);
    root->m_kMatrix.m[15] = 1.0f;
}

// Message 144 says only that a profile does not fit; this says why.
void CGaitConvertContent::ReportMisfit()
{
    EMisfit misfit = EMisfit::NoRootSource;
    if (!SourceRoot() || !m_kResultMotion.motionRoot)
        misfit = EMisfit::NoScene;
    else if (m_kProfilePath.empty())
        misfit = EMisfit::NoProfile;
    else if (ReportMissingBones())
        return;
    else if (!m_pkProfile->HasRootMapping())
        misfit = EMisfit::NoRootRow;
    m_kWindow.Report(MakeReport(m_kProfilePath, misfit));
}

// Reports the rows that name bones which are not there; false when there is none. A profile that lies in its
// file as it is tells the lines.
bool CGaitConvertContent::ReportMissingBones()
{
    CNode* const target = m_kResultMotion.motionRoot.Get();
    CProfileFit fit;
    if (m_pkProfileDialog->IsDirty() || !MeasureFit(m_kProfilePath, SourceRoot(), target, fit))
    {
        fit = MeasureFit(m_pkProfileDialog->Rows(), SourceRoot(), target);
        m_pkProfile->GetProfileName(fit.name);
    }
    if (!fit.missing.empty())
        m_kWindow.Report(MisfitReport(m_kSourcePath, fit));
    return !fit.missing.empty();
}

} // namespace gw
