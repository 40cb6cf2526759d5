// Drafts a profile for the open source, and reports the faults of a file that cannot be read well.

#include "CBoneMapProfile.h"
#include "CContentWindow.h"
#include "CFileExam.h"
#include "CGaitConvertContent.h"
#include "CProfileEditorDialog.h"
#include "CSafeFile.h"
#include "CWaitCursor.h"
#include "FindingWords.h"
#include "NewProfilePath.h"
#include "Paths.h"
#include "ProfileFile.h"
#include "SourceTiming.h"
#include "StringTable.h"
#include "SuggestProfile.h"
#include "SystemError.h"
#include "Text.h"

#include <filesystem>

namespace gw {

namespace {

constexpr uint64_t kExamBytesLimit = uint64_t{16} << 20; // a person would have to wait for more

// Returns the rows that a person should check, or empty.
std::string UnsureRows(const SuggestedProfile& draft)
{
    std::string names;
    for (const SuggestedRow& row : draft.rows)
    {
        if (row.IsMapping() && row.sureness == ERowSureness::Unsure)
            names.append(names.empty() ? "" : ", ").append(row.target);
    }
    return names;
}

bool IsShort(const std::string& path)
{
    std::error_code error;
    const uint64_t size = std::filesystem::file_size(path, error);
    return !error && size <= kExamBytesLimit;
}

} // namespace

std::string CGaitConvertContent::DraftName() const
{
    return FreeName(SuggestedName(SplitPath(m_kSourcePath).stem));
}

// Returns an unused name, because a second profile with the same name could not be selected.
std::string CGaitConvertContent::FreeName(const std::string& name) const
{
    std::string free = name;
    for (int number = 2; IsListed(free); ++number)
        free = name + ' ' + std::to_string(number);
    return free;
}

int CGaitConvertContent::DraftProfile()
{
    CNode* const target = m_kBaseMotion.motionRoot.Get();
    if (!SourceRoot() || !target || !m_pkProfile)
        return 0;
    const CWaitCursor wait(window_);
    const SuggestedProfile draft = SuggestProfile(*SourceRoot(), *target);
    m_kNextSteps.SetUndraftable(!draft.missing.empty());
    if (!draft.missing.empty())
    {
        ShowCaptions();
        window_.ShowMessageBox(kOwnMessage,
                               "No human body was found in this motion, so no bone map can be drafted.",
                               EButtons::OK);
        return 0;
    }
    const std::string name = DraftName();
    const std::string path = NewProfilePath(*this);
    if (!SaveNewMap(path, ProfileText(name, ProfileRateOf(SourceRoot()), kVec3Zero, draft.Table())))
        return 0;
    OpenDraft(name);
    if (const std::string rows = UnsureRows(draft); !rows.empty())
        window_.Notify(MakeNotice(path, "unsure-rows", "check these rows of the bone map: " + Printable(rows),
                                  ESeverity::Warning));
    return 1;
}

// Selects a new profile and shows it in the editor.
void CGaitConvertContent::OpenDraft(const std::string& name)
{
    RefreshProfileList();
    MeasureFits();
    SelectProfileByName(name);
    m_pkProfileDialog->Show();
    window_.ShowProfileEditor(true);
    UpdateControls();
}

// All faults that a reader ran into are reported if a person can unfold them.
void CGaitConvertContent::NotifyOfFindings(const std::string& path)
{
    if (!window_.ShowsFindings() || !HasExtension(path, ".bvh") || !IsShort(path))
        return;
    CFileExam exam;
    exam.ExamineBVH(path);
    m_kNextSteps.SetMendable(exam.Findings().MendsAny() ? path : "");
    for (const Finding& finding : exam.Findings().Sorted())
    {
        if (finding.severity != ESeverity::Note && !IsOfReader(finding.reason))
            window_.Notify(MakeNotice(path, finding));
    }
}

// The copy is a new file next to the original. It is opened on request, so the way to a result is shortened.
void CGaitConvertContent::OpenMendedCopy()
{
    const std::string original = m_kNextSteps.Mendable();
    if (original.empty() || !ConfirmDiscard())
        return;
    const PathParts parts = SplitPath(original);
    const std::string copy = parts.folder + parts.stem + " (mended)";
    std::string path = copy + parts.extension;
    for (int number = 2; FileExists(path); ++number)
        path = copy + ' ' + std::to_string(number) + parts.extension;
    CFileExam exam;
    exam.ExamineBVH(original);
    CSafeFile::KeepExisting(path);
    if (exam.WriteMended(path))
    {
        if (Open(path) != 0)
            UseSureMap();
        return;
    }
    window_.Notify(MakeNotice(path, {.reason = EFailure::WriteError, .systemError = TakeSystemError()}));
    window_.ShowMessageBox(kOwnMessage, "The mended copy cannot be written.", EButtons::OK);
}

void CGaitConvertContent::UseSureMap()
{
    const ProfileChoice* const best = m_kNextSteps.Fits().Best();
    if (m_kProfilePath.empty() && best && best->verdict.sureness == ESureness::Sure)
        UseBestMap();
}

} // namespace gw
