#pragma once

#include "CCntComboExControl.h"
#include "CContentWindow.h"
#include "COptions.h"

#include <cstddef>
#include <set>
#include <string>
#include <vector>

namespace gw {

/// The window of a program that has none: dialogs are answered from the command line, message boxes and
/// reports become words on standard error, questions are answered so that nothing is overwritten or opened.
class CShellWindow : public CContentWindow
{
public:
    /// The options must outlive the window.
    explicit CShellWindow(const COptions& options) : m_kOptions(options) {}

    /// What the open and the save dialog answer; empty cancels.
    void SetPaths(const std::string& source, const std::string& output);

    /// Whether anything was reported that is no warning.
    bool HasFailed() const { return m_bFailed; }
    /// Everything that was reported, in order.
    const std::vector<CReport>& Reports() const { return m_kReports; }
    /// Number of files that a batch run has taken up.
    size_t BatchFileCount() const { return m_uiBatchFiles; }
    /// Whether a child takes a click, as the conversion last said.
    bool IsEnabled(std::string_view child) const { return m_kEnabled.contains(child); }

    EAnswer ShowMessageBox(int id, const std::string& text, EButtons buttons) override;
    std::optional<std::string> AskOpenFile(const CFileDialogSetup& setup) override;
    std::optional<std::string> AskSaveFile(const CFileDialogSetup& setup) override;
    std::optional<CFolderChoice> AskFolder(const CFileDialogSetup& setup) override;
    bool IsKeyDown(EKey key) const override;
    void Report(const CReport& report) override;
    void ShowBatchFile(size_t index, size_t count, const std::string& path) override;
    void EnableChild(std::string_view child, bool enabled) override;
    CCntComboExControl& CreateComboEx(std::string_view, std::string_view, int) override
    {
        return m_kProfiles;
    }

private:
    const COptions& m_kOptions;
    CProfileList m_kProfiles;
    std::string m_kSource;
    std::string m_kOutput;
    std::set<std::string, std::less<>> m_kEnabled;
    std::vector<CReport> m_kReports;
    size_t m_uiBatchFiles = 0;
    bool m_bFailed = false;
};

} // namespace gw
