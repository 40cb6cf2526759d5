// One folder, every file of a kind, no questions: sources to HTR files, or HTR files to containers.

#include "CCntComboExControl.h"
#include "CContentWindow.h"
#include "CGaitConvertContent.h"
#include "CProfileEditorDialog.h"
#include "CWaitCursor.h"
#include "FailureWords.h"
#include "Packaging.h"
#include "Paths.h"
#include "SourceTiming.h"
#include "StringTable.h"

namespace gw {

namespace {

constexpr const char* kFilter = "BVH file to HTR(*.bvh)|*.bvh|HTR file to ORN(*.htr)|*.htr|";
// Unlike an interactive save: at a profile rate of 30 the frames stay as many as they are.
constexpr float kBatchRate = 30.0f;
constexpr float kPackageRate = 60.0f;

} // namespace

std::string_view BatchSource(EBatchJob job)
{
    return job == EBatchJob::ToMotion ? ".bvh" : ".htr";
}

std::string_view BatchResult(EBatchJob job)
{
    return job == EBatchJob::ToMotion ? ".htr" : ".orn";
}

int CGaitConvertContent::RunBatch()
{
    return RunBatch({});
}

int CGaitConvertContent::RunBatch(const std::string& initialFolder)
{
    const auto choice =
        m_kWindow.AskFolder({{}, kFilter, initialFolder.empty() ? SourceFolder() : initialFolder});
    if (!choice)
        return 0;
    m_kWindow.RedrawFrame();
    const CWaitCursor wait(m_kWindow);
    const EBatchJob job = choice->filterIndex == 1 ? EBatchJob::ToMotion : EBatchJob::ToContainer;
    const std::string folder = WithSeparator(choice->folder);
    const std::vector<std::string> names = FilesInFolder(folder, BatchSource(job));
    if (names.empty())
        return 0;
    EBatchStep step = EBatchStep::Done;
    size_t finished = 0;
    while (finished < names.size() && step == EBatchStep::Done)
    {
        const std::string path = folder + names[finished];
        step = RunBatchFile(job, path, WithExtension(path, BatchResult(job)), finished, names.size());
        finished += step == EBatchStep::Done ? 1 : 0;
    }
    if (step == EBatchStep::Abandoned)
        return 0;
    TellBatch(job, finished);
    return 1;
}

EBatchStep CGaitConvertContent::RunBatchFile(EBatchJob job, const std::string& source,
                                             const std::string& output, size_t index, size_t count)
{
    ShowBatchFile(source, index, count);
    return job == EBatchJob::ToMotion ? ConvertFile(source, output) : PackageFile(source, output);
}

void CGaitConvertContent::TellBatch(EBatchJob job, size_t finished)
{
    const int count[] = {static_cast<int>(finished)};
    ShowMessage(job == EBatchJob::ToMotion ? kConvertedMessage : kPackagedMessage, EButtons::OK, count);
    SetTitle({});
}

void CGaitConvertContent::ShowBatchFile(const std::string& path, size_t index, size_t count)
{
    const std::string arguments[] = {std::to_string(index + 1), SplitPath(path).stem};
    SetTitle(FormatText(Message(kBatchTitleMessage), arguments));
    m_kWindow.ShowBatchFile(index, count, path);
    ForViews(&CMotionView::Stop);
    m_kWindow.StayPainted();
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
    const SourceTiming timing = TimingOf(m_kSourceMotion);
    if (!SelectProfileAgain() || !PrepareRetargeter() || !PrepareSource(timing))
    {
        ShowMessage(kCannotConvertMessage, EButtons::OK);
        return EBatchStep::Abandoned;
    }
    Retarget(timing, true); // Shift has no say here
    m_kWriteRecord.Clear();
    const bool saved = WriteMotion(output, kBatchRate);
    Report(path, m_kWriteRecord);
    return saved ? EBatchStep::Done : EBatchStep::Ended;
}

// The profile is read from its file again for every source.
bool CGaitConvertContent::SelectProfileAgain()
{
    const CCntComboExControl& list = *m_pkProfileCombo;
    const std::string* const selected = list.GetItemText(list.GetCurSel());
    if (!selected)
    {
        m_kWindow.Report(MakeReport({}, EMisfit::NoProfile));
        return false;
    }
    SelectProfileByName(std::string(*selected));
    return true;
}

EBatchStep CGaitConvertContent::PackageFile(const std::string& path, const std::string& output)
{
    CFailureRecord record;
    const bool packaged = PackageMotion(path, output, kPackageRate, kPackageRate, record);
    Report(path, record);
    return packaged ? EBatchStep::Done : EBatchStep::Abandoned;
}

} // namespace gw
