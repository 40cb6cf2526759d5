// Converts all files of a kind in one folder without asking: sources to HTR files, or HTR files to
// containers.

#include "CBoneMapProfile.h"
#include "CCntComboExControl.h"
#include "CContentWindow.h"
#include "CGaitConvertContent.h"
#include "CWaitCursor.h"
#include "FindingWords.h"
#include "Paths.h"
#include "StringTable.h"
#include "Text.h"

namespace gw {

namespace {

constexpr const char* kFilter = "BVH file to HTR(*.bvh)|*.bvh|HTR file to ORN(*.htr)|*.htr|";

} // namespace

int CGaitConvertContent::RunBatch(const std::string& initialFolder)
{
    const auto choice = window_.AskFolder(
        {{}, kFilter, initialFolder.empty() ? SourceFolder() : initialFolder, {}, BatchNote()});
    if (!choice)
        return 0;
    window_.RedrawFrame();
    const CWaitCursor wait(window_);
    const EBatchJob job = choice->filterIndex == 1 ? EBatchJob::ToMotion : EBatchJob::ToContainer;
    const std::string folder = WithSeparator(choice->folder);
    const std::vector<std::string> names = FilesInFolder(folder, BatchSource(job));
    if (names.empty())
        return 0;
    ClearMarks();
    EBatchStep step = EBatchStep::Done;
    size_t finished = 0;
    while (finished < names.size() && step == EBatchStep::Done)
    {
        step = RunBatchFile(job, folder + names[finished], finished);
        finished += step == EBatchStep::Done ? 1 : 0;
    }
    if (step == EBatchStep::Abandoned)
        return 0;
    const int count[] = {static_cast<int>(finished)};
    ShowMessage(job == EBatchJob::ToMotion ? kConvertedMessage : kPackagedMessage, EButtons::OK, count);
    SetTitle({});
    return 1;
}

// Returns what a batch run would do.
std::string CGaitConvertContent::BatchNote() const
{
    const CCntComboExControl& list = *m_pkProfileCombo;
    const std::string* const selected = list.GetItemText(list.GetCurSel());
    const std::string map = selected ? "BVH files are converted with the bone map " + Quoted(*selected) + '.'
                                     : "No bone map is selected, so BVH files cannot be converted.";
    return map + "\nResults are written next to their sources and replace files with the same name.";
}

EBatchStep CGaitConvertContent::RunBatchFile(EBatchJob job, const std::string& path, size_t index)
{
    const std::string arguments[] = {std::to_string(index + 1), SplitPath(path).stem};
    SetTitle(FormatText(Message(kBatchTitleMessage), arguments));
    ForViews(&CMotionView::Stop);
    window_.StayPainted();
    const std::string output = WithExtension(path, BatchResult(job));
    return job == EBatchJob::ToMotion ? ConvertFile(path, output) : PackageFile(path, output);
}

EBatchStep CGaitConvertContent::ConvertFile(const std::string& path, const std::string& output)
{
    if (!LoadMotion(m_kSourceMotion, path))
    {
        ShowMessage(kInvalidSourceMessage, EButtons::OK);
        return EBatchStep::Ended;
    }
    m_bSourceIsContainer = false;
    m_kSourcePath = path;
    RememberFolder(path);
    ShowSource();
    if (!SelectProfileAgain() || !Retarget(false))
        return EBatchStep::Abandoned;
    m_kWriteRecord.Clear();
    const bool saved =
        WriteMotionFile(m_kResultMotion, output, kBatchRate, m_pkProfile->GetFrameRate(), m_kWriteRecord);
    Notify(path, m_kWriteRecord);
    return saved ? EBatchStep::Done : EBatchStep::Ended;
}

// Reads the profile from its file again for every source.
bool CGaitConvertContent::SelectProfileAgain()
{
    const CCntComboExControl& list = *m_pkProfileCombo;
    const std::string* const selected = list.GetItemText(list.GetCurSel());
    if (!selected)
    {
        window_.Notify(MakeNotice({}, {EFailure::NoProfile}));
        ShowMessage(kCannotConvertMessage, EButtons::OK);
        return false;
    }
    SelectProfileByName(std::string(*selected));
    return true;
}

EBatchStep CGaitConvertContent::PackageFile(const std::string& path, const std::string& output)
{
    CFailureRecord record;
    const bool packaged = PackageMotionFile(path, output, record);
    Notify(path, record);
    return packaged ? EBatchStep::Done : EBatchStep::Abandoned;
}

} // namespace gw
