// Asks for a file, saves the result there, and reports it.

#include "CBoneMapProfile.h"
#include "CContentWindow.h"
#include "CGaitConvertContent.h"
#include "CWaitCursor.h"
#include "FindingWords.h"
#include "ResultFile.h"
#include "StringTable.h"

namespace gw {

namespace {

constexpr const char* kNotSaved = "not saved: "; // prefix of the title after a failed save

} // namespace

int CGaitConvertContent::SaveResult()
{
    const auto path = window_.AskSaveFile({"Kinetra", Message(kSaveFilterMessage), {}});
    if (!path)
        return 1;
    const CWaitCursor wait(window_);
    WriteResult(*path);
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
