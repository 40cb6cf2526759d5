#pragma once

#include "CChoosingConversion.h"
#include "CMendedSource.h"
#include "CSourceFile.h"

#include <string>

namespace gw {

class CDraftShelf;
class CShellNotices;
struct ShellOptions;

/// The conversion of the shell program.
class CShellConversion : public CChoosingConversion
{
public:
    /// Options and notices must outlive the conversion.
    CShellConversion(const ShellOptions& options, const ConversionChoices& choices, CShellNotices& notices);

    /// With the option --draft: where drafted profiles are found and kept. Must outlive the conversion.
    void UseDrafts(CDraftShelf& drafts) { m_pkDrafts = &drafts; }

    /// Reads a source, repaired if the options say so. Returns false, after reporting the reason, if that
    /// fails.
    bool ReadSource(const std::string& path);
    /// Opens a source and loads the target. If no profile was named, selects a stock profile that fits.
    /// Returns false, after reporting the reason, if anything failed.
    bool Open(const std::string& path);
    /// Returns whether the profile was drafted for the source's skeleton.
    bool IsDrafted() const { return m_bDrafted; }
    /// Returns the copy that was read in place of the source, and what was repaired in it.
    const CMendedSource& Mended() const { return m_kMended; }
    /// Returns the file that was read: the source, or a copy that exists as long as the conversion.
    const std::string& ReadPath() const { return m_kMended.IsMended() ? m_kMended.Path() : m_kSource.Path(); }
    /// Saves the result in the format of the extension, changed as the options say. `taken` as for
    /// WriteResult.
    bool WriteEdited(const std::string& path, bool* taken = nullptr);
    /// Returns the changes that the options ask for.
    MotionEdits Edits() const;

protected:
    bool UseDraft() override;
    void NotifyOfNone(const Notice& notice) const override;

private:
    const ShellOptions& options_;
    const CShellNotices& notices_;
    CSourceFile m_kSource;
    CMendedSource m_kMended;
    CDraftShelf* m_pkDrafts = nullptr;
    bool m_bDrafted = false;
    std::string m_kWhyNoDraft;   ///< empty if no draft was tried
    bool m_bDraftUnsure = false; ///< there is one that a person could check
};

} // namespace gw
