#include "CShellWindow.h"

#include "Paths.h"
#include "StringTable.h"
#include "Text.h"
#include "Words.h"

#include <algorithm>

namespace gw {

namespace {

// The messages that say how a run ended; whoever asked for silence knows that from the exit code.
constexpr int kSummaries[] = {kConvertedMessage, kPackagedMessage};

std::optional<std::string> Answer(const std::string& path)
{
    return path.empty() ? std::nullopt : std::optional(path);
}

// The job's number in the filter of the folder dialog.
int FilterOf(const COptions& options)
{
    return options.job == "htr" ? 1 : 2;
}

} // namespace

void CShellWindow::SetPaths(const std::string& source, const std::string& output)
{
    m_kSource = source;
    m_kOutput = output;
}

EAnswer CShellWindow::ShowMessageBox(int id, const std::string& text, EButtons buttons)
{
    if (buttons == EButtons::YesNo || buttons == EButtons::YesNoCancel)
        return EAnswer::No;
    if (buttons == EButtons::OKCancel)
        return EAnswer::Cancel;
    if (std::ranges::count(kSummaries, id) != 0)
        SayWord(m_kOptions, text);
    else
        SayError(text);
    return EAnswer::OK;
}

std::optional<std::string> CShellWindow::AskOpenFile(const CFileDialogSetup&)
{
    return Answer(m_kSource);
}

std::optional<std::string> CShellWindow::AskSaveFile(const CFileDialogSetup&)
{
    return Answer(m_kOutput);
}

std::optional<CFolderChoice> CShellWindow::AskFolder(const CFileDialogSetup&)
{
    return CFolderChoice{WithSeparator(m_kOptions.files[0]), FilterOf(m_kOptions)};
}

bool CShellWindow::IsKeyDown(EKey key) const
{
    return key == EKey::LeftShift && m_kOptions.noLegs;
}

void CShellWindow::Report(const CReport& report)
{
    m_kReports.push_back(report);
    m_bFailed = m_bFailed || !report.warning;
    SayReport(m_kOptions, report);
}

void CShellWindow::ShowBatchFile(size_t index, size_t count, const std::string& path)
{
    m_uiBatchFiles = index + 1;
    SayWord(m_kOptions,
            Printable(path) + " (" + std::to_string(index + 1) + " of " + std::to_string(count) + ')');
}

void CShellWindow::EnableChild(std::string_view child, bool enabled)
{
    if (enabled)
        m_kEnabled.emplace(child);
    else if (const auto found = m_kEnabled.find(child); found != m_kEnabled.end())
        m_kEnabled.erase(found);
}

} // namespace gw
