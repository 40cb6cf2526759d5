#include "ConvertMotionFile.h"

#include "CCntComboExControl.h"
#include "CContentWindow.h"
#include "CFilePlatform.h"
#include "CProfileFields.h"
#include "ProfileFile.h"

#include <algorithm>

namespace gw {

namespace {

CReport Failure(const std::string& path, const char* code, const std::string& words)
{
    return {false, path, 0, code, {}, words};
}

// A window that nobody sees: it keeps what is said, and declines what is asked.
class CUnseenWindow : public CContentWindow
{
public:
    explicit CUnseenWindow(std::vector<CReport>& reports) : m_kReports(reports) {}

    bool HasFailed() const { return !std::ranges::all_of(m_kReports, &CReport::warning); }
    bool MayConvert() const { return m_bMayConvert; }

    EAnswer ShowMessageBox(int id, const std::string& text, EButtons buttons) override
    {
        if (buttons != EButtons::OK)
            return buttons == EButtons::OKCancel ? EAnswer::Cancel : EAnswer::No;
        m_kReports.push_back(Failure({}, "message", text));
        m_kReports.back().warning = id == kNumberLimitsMessage; // such a number counts all the same
        return EAnswer::OK;
    }
    std::optional<std::string> AskOpenFile(const CFileDialogSetup&) override { return std::nullopt; }
    std::optional<std::string> AskSaveFile(const CFileDialogSetup&) override { return std::nullopt; }
    std::optional<CFolderChoice> AskFolder(const CFileDialogSetup&) override { return std::nullopt; }
    void Report(const CReport& report) override { m_kReports.push_back(report); }
    void EnableChild(std::string_view child, bool enabled) override
    {
        if (child == "convert")
            m_bMayConvert = enabled;
    }
    CCntComboExControl& CreateComboEx(std::string_view, std::string_view, int) override
    {
        return m_kProfiles;
    }

private:
    std::vector<CReport>& m_kReports;
    CProfileList m_kProfiles;
    bool m_bMayConvert = false;
};

bool UseProfile(CGaitConvertContent& content, CUnseenWindow& window, const std::string& path)
{
    std::string text;
    if (!ReadProfileText(path, text))
    {
        window.Report(Failure(path, "profile", "the profile cannot be read"));
        return false;
    }
    content.UseProfileFile(path);
    content.UpdateControls();
    return true;
}

// The state of the window's button is the rule. Source, target and profile are there, so that only frames can
// lack; a container may say that it ends before it begins.
bool Convert(CGaitConvertContent& content, CUnseenWindow& window, const std::string& source)
{
    if (window.MayConvert() && (content.ConvertMotion() == 0 || window.HasFailed()))
        return false;
    if (window.MayConvert() && content.ResultMotion().GetKeyCount() > 0)
        return true;
    window.Report(Failure(source, "no-frames", "the motion has no frames, so there is nothing to convert"));
    return false;
}

} // namespace

MotionFileResult ConvertMotionFile(const MotionFileJob& job)
{
    MotionFileResult result;
    CUnseenWindow window(result.reports);
    CFilePlatform platform(EPlatformWriting::No, job.dataFolder);
    CGaitConvertContent content(window, platform);
    content.OnInitContent(); // its answer tells of the views, which are not seen either
    content.SetChoices(job.choices);
    result.written = content.OpenFile(job.source) != 0 && !window.HasFailed() &&
                     UseProfile(content, window, job.profile) && Convert(content, window, job.source) &&
                     content.WriteResult(job.output) && !window.HasFailed();
    return result;
}

} // namespace gw
