// Asks for a file, saves the result there, and reports it.

#include "CBoneMapProfile.h"
#include "CContentWindow.h"
#include "CLongStep.h"
#include "CWaitCursor.h"
#include "FindingWords.h"
#include "Paths.h"
#include "ResultFile.h"
#include "StringTable.h"

namespace gw {

namespace {

constexpr const char* kNotSaved = "not saved: "; // prefix of the title after a failed save

} // namespace

int CGaitConvertContent::SaveResult()
{
    const PathParts proposal = SplitPath(m_kSavedPath.empty() ? m_kSourcePath : m_kSavedPath);
    const auto path =
        window_.AskSaveFile({"Kinetra", Message(kSaveFilterMessage), proposal.folder, proposal.stem});
    if (!path)
        return 1;
    const CWaitCursor wait(window_);
    try
    {
        const CLongStep step(*this);
        if (WriteResult(*path))
            m_kSavedPath = m_kResultFile = *path;
    } catch (const CCanceled&)
    {
        m_kResultMotion.motionRoot->UpdateScene(0.0f, true); // as after a complete save
        return 1;
    }
    m_bSaved = true; // set even if saving failed: title and message box report that
    std::string title;
    std::string text = Message(kShowFileMessage);
    if (m_kWriteRecord.Failure())
    {
        const Notice notice = MakeNotice(*path, m_kWriteRecord.Failure());
        title = kNotSaved + notice.words;
        text = "Nothing was written.\n" + NoticeLine(notice) + "\n\n" + text;
    }
    SetTitle(title);
    ShowCaptions();
    if (window_.ShowMessageBox(kShowFileMessage, text, EButtons::OKCancel) == EAnswer::OK)
        window_.ShowInFileManager(*path);
    return 1;
}

// The next step clears the title's report about the last save.
void CGaitConvertContent::ForgetFailedSave()
{
    if (m_kTitle.starts_with(kNotSaved))
        SetTitle({});
}

bool CGaitConvertContent::WriteResult(const std::string& path)
{
    m_kWriteRecord.Clear();
    const bool written = WriteResultFile(m_kResultMotion, path, m_pkProfile->GetFrameRate(), m_kWriteRecord);
    Notify(path, m_kWriteRecord);
    return written;
}

} // namespace gw
