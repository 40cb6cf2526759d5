// Converts the open source with the selected profile.

#include "AlignMotion.h"
#include "CContentWindow.h"
#include "CGaitConvertContent.h"
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
    ReloadResult();
    if (m_pkProfile)
        m_pkProfile->SetResultScene(m_kResultMotion.motionRoot.Get());
    if (!Retarget(true))
        return 0;
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
    conversion.Run(useLegs, [this](size_t done, size_t total) { ShowProgress(done, total); });
    const SourceTiming result = TimingOf(m_kResultMotion);
    if (m_pkResultView)
        m_pkResultView->SetScene(m_kResultMotion.motionRoot.Get(), result.FrameStep(), result.lastFrame);
    ShowTitle(m_kTitle);
    return true;
}

ConversionInput CGaitConvertContent::Input() const
{
    CNode* const root = SourceRoot();
    ConversionInput input{.sourcePath = m_kSourcePath,
                          .source = root,
                          .timing = m_bSourceIsContainer ? TimingOf(ConversionTrack(root))
                                                         : TimingOf(m_kSourceMotion),
                          .sourceRecord = m_kSourceMotion.Record(),
                          .profilePath = m_kProfilePath,
                          .profileName = {},
                          .rows = m_pkProfileDialog->Rows(),
                          .areRowsEdited = m_pkProfileDialog->IsDirty(),
                          .choices = m_kChoices};
    m_pkProfile->GetProfileName(input.profileName);
    return input;
}

void CGaitConvertContent::ShowProgress(size_t done, size_t total)
{
    if (!window_.IsProgressDue())
        return;
    const std::string percent = std::to_string(100 * done / total) + " %";
    ShowTitle(m_kTitle.empty() ? "Converting " + percent : m_kTitle + ", " + percent);
    window_.StayPainted();
}

} // namespace gw
