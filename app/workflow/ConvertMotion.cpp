// Converts the open source with the selected profile.

#include "AlignMotion.h"
#include "CContentWindow.h"
#include "CLongStep.h"
#include "CProfileEditorDialog.h"
#include "CWaitCursor.h"
#include "SourceTiming.h"
#include "StringTable.h"

namespace gw {

int CGaitConvertContent::ConvertMotion()
{
    const CWaitCursor wait(window_);
    ForgetFailedSave();
    ForViews(&CMotionView::Stop);
    const CMotionFile before(m_kResultMotion);
    ReloadResult();
    if (m_pkProfile)
        m_pkProfile->SetResultScene(m_kResultMotion.motionRoot.Get());
    NotifyOfPose();
    try
    {
        const CLongStep step(*this);
        m_bConversionFailed = !Retarget(true);
    } catch (const CCanceled&)
    {
        PutBackResult(before);
        return 0;
    }
    if (m_bConversionFailed)
    {
        ShowCaptions();
        return 0;
    }
    if (m_pkSourceView)
        m_pkSourceView->Seek(0, kScrollRange);
    m_bConverted = true;
    UpdateControls();
    return 1;
}

// The stamp is read first, so that a change during reading makes the next conversion read the file again.
void CGaitConvertContent::LoadResult()
{
    const std::optional<FileStamp> stamp = StampOf(BaseFile());
    resultStamp_ = m_kResultMotion.Load(BaseFile()) ? stamp : std::nullopt;
}

// Every conversion starts with the skeleton as its file has it now. The first one after an open reuses the
// skeleton that was read at open, unless the file has changed since.
void CGaitConvertContent::ReloadResult()
{
    if (!resultStamp_ || resultStamp_ != StampOf(BaseFile()))
        LoadResult();
    Notify(BaseFile(), m_kResultMotion.Record());
}

// Converts with the profile. If that cannot drive a conversion, reports why and returns false. The source is
// looked up after the profile's message boxes, because another source may be opened while they are shown.
bool CGaitConvertContent::Retarget(bool heedsShift)
{
    CRetargeter& retargeter = m_kRetargeter.emplace();
    const bool fits =
        m_pkProfile->ApplyProfile(&retargeter, nullptr, nullptr) && m_pkProfile->HasRootMapping();
    CConversion conversion(Input(), m_kResultMotion, retargeter,
                           [this](const Notice& notice) { window_.Notify(notice); });
    resultStamp_.reset();
    if (!conversion.Prepare(fits, EAlignedJoints::Body))
    {
        ShowMessage(kCannotConvertMessage, EButtons::OK);
        return false;
    }
    const bool useLegs = !heedsShift || !window_.IsKeyDown(EKey::LeftShift);
    conversion.Run(useLegs, ProgressOf("Converting"));
    const SourceTiming result = TimingOf(m_kResultMotion);
    if (m_pkResultView)
        m_pkResultView->SetScene(m_kResultMotion.motionRoot.Get(), result.FrameStep(), result.lastFrame);
    m_kOrigin = {MapName(), m_pkProfileDialog->Rows(), m_kChoices, useLegs, result};
    m_kResultFile.clear();
    ShowTitle(m_kTitle);
    if (heedsShift) // one conversion, not one of many
        StartMarks(conversion.Aligned() ? *conversion.Aligned() : *SourceRoot());
    return true;
}

ConversionInput CGaitConvertContent::Input() const
{
    CNode* const root = SourceRoot();
    ConversionInput input{.sourcePath = m_kSourcePath,
                          .source = root,
                          .timing = Timing(),
                          .sourceRecord = m_kSourceMotion.Record(),
                          .profilePath = m_kProfilePath,
                          .profileName = {},
                          .rows = m_pkProfileDialog->Rows(),
                          .areRowsEdited = m_pkProfileDialog->IsDirty(),
                          .choices = m_kChoices};
    m_pkProfile->GetProfileName(input.profileName);
    return input;
}

// Shows the result from before a canceled conversion again. If there was none, the skeleton may have been
// partly baked and is read again.
void CGaitConvertContent::PutBackResult(const CMotionFile& before)
{
    if (m_kOrigin)
    {
        m_kResultMotion.motionRoot = before.motionRoot;
        m_kResultMotion.restRoot = before.restRoot;
        m_kResultMotion.quarterTurns = before.quarterTurns;
    }
    else
        LoadResult();
    if (m_pkProfile)
        m_pkProfile->SetResultScene(m_kResultMotion.motionRoot.Get());
    UpdateControls();
}

} // namespace gw
