// From the target's motion to a file: a Kinetra package around an HTR, or the HTR alone.

#include "CContentWindow.h"
#include "CGaitConvertContent.h"
#include "CPackageFile.h"
#include "CProfileEditorDialog.h"
#include "CWaitCursor.h"
#include "FailureWords.h"
#include "Paths.h"
#include "StringTable.h"

namespace gw {

namespace {

constexpr std::string_view kPackageExtension = ".Kinetra";
constexpr std::string_view kMotionExtension = ".htr";
constexpr const char* kNotSaved = "not saved: "; // begins the title after a failed save
// The host plays packages at this rate: a result is stored in half-steps of it.
constexpr float kSavedRate = 120.0f;
constexpr float kHostRate = 60.0f;

} // namespace

int CGaitConvertContent::SaveResult()
{
    const auto path = m_kWindow.AskSaveFile({"Kinetra", Message(kSaveFilterMessage), {}});
    if (!path)
        return 1;
    const CWaitCursor wait(m_kWindow);
    WriteResult(*path);
    m_bSaved = true; // even if it was not: the title and the box report that
    std::string title;
    std::string text = Message(kShowFileMessage);
    if (m_kWriteRecord.Failure())
    {
        const CReport report = MakeReport(*path, m_kWriteRecord.Failure(), false);
        title = kNotSaved + report.words;
        text = "Nothing was written.\n" + ReportLine(report) + "\n\n" + text;
    }
    SetTitle(title);
    if (m_kWindow.ShowMessageBox(kShowFileMessage, text, EButtons::OKCancel) == EAnswer::OK)
        m_kWindow.ShowInFileManager(*path);
    return 1;
}

// The next step ends what the title reports of the last save.
void CGaitConvertContent::ForgetFailedSave()
{
    if (m_kTitle.starts_with(kNotSaved))
        SetTitle({});
}

bool CGaitConvertContent::WriteResult(const std::string& path)
{
    m_kWriteRecord.Clear();
    const bool written = HasExtension(path, kPackageExtension)
                             ? WritePackage(path)
                             : WriteMotion(WithExtension(path, kMotionExtension), kSavedRate);
    Report(path, m_kWriteRecord);
    return written;
}

// The motion's text goes straight into the package, so that an HTR beside the chosen name stays as it is.
bool CGaitConvertContent::WritePackage(const std::string& path)
{
    const auto rate = static_cast<float>(ProfileRate());
    CPackageFile package;
    const auto append = [&](std::span<const std::byte> bytes) {
        return package.Write(bytes) || m_kWriteRecord.Fail(package.Failure());
    };
    const auto write = [&](float frameScale) { return m_kResultMotion.SaveText(append, frameScale); };
    if (!package.Open(path, {FormatCode(std::string(kMotionExtension)), rate, kHostRate}))
        return m_kWriteRecord.Fail(package.Failure());
    return SaveMotion(kSavedRate, write) && (package.Commit() || m_kWriteRecord.Fail(package.Failure()));
}

bool CGaitConvertContent::WriteMotion(const std::string& path, float rate)
{
    return SaveMotion(rate, [&](float frameScale) { return m_kResultMotion.Save(path, frameScale); });
}

// Saves the result with as many times more frames as a rate stands above the profile's.
bool CGaitConvertContent::SaveMotion(float rate, const std::function<bool(float frameScale)>& save)
{
    if (ProfileRate() <= 0)
        return m_kWriteRecord.Fail(EFailure::BadNumber, 0, "FrameRate " + std::to_string(ProfileRate()));
    const bool saved = save(rate / static_cast<float>(ProfileRate()));
    const CFailure& failure = m_kResultMotion.Record().Failure();
    return saved || m_kWriteRecord.Fail(failure.reason, failure.where, failure.name);
}

int CGaitConvertContent::ProfileRate() const
{
    return m_pkProfile ? m_pkProfile->GetFrameRate() : 0;
}

std::string CGaitConvertContent::WithExtension(const std::string& path, std::string_view extension)
{
    const CPathParts parts = SplitPath(path);
    return parts.folder + parts.stem + std::string(extension);
}

} // namespace gw
