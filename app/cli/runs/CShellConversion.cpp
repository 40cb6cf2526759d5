// Reads sources and writes results as the options say. Drafted bone maps are shared by the sources of a run
// that have the same skeleton.

#include "CShellConversion.h"

#include "CDraftShelf.h"
#include "CShellNotices.h"
#include "DraftedProfile.h"
#include "HelpWords.h"
#include "Paths.h"
#include "ProfileNames.h"
#include "ShellOptions.h"
#include "SkeletonDigits.h"
#include "Streams.h"
#include "SuggestProfile.h"
#include "SystemError.h"
#include "Text.h"
#include "Words.h"

namespace gw {

CShellConversion::CShellConversion(const ShellOptions& options, const ConversionChoices& choices,
                                   CShellNotices& notices)
    : CChoosingConversion(options.dataFolder, options.profile, choices,
                          [&](const Notice& notice) { notices.Add(notice); }),
      options_(options), notices_(notices)
{
}

bool CShellConversion::ReadSource(const std::string& path)
{
    SelectSource(options_.clip, options_.rate);
    if (!m_kSource.Open(path, EPackage::Unpacked))
    {
        Notify(m_kSource.Failure());
        return false;
    }
    if (!options_.mend || m_kMended.Mend(m_kSource.Path()))
        return LoadSource(path, ReadPath());
    Notify(MakeNotice(path, "no-mended-copy",
                      "a repaired copy cannot be written to the folder for temporary files" +
                          TakeSystemErrorWords()));
    return false;
}

MotionEdits CShellConversion::Edits() const
{
    MotionEdits edits{.inPlace = options_.inPlace, .mirror = options_.mirror};
    if (!options_.frames.empty())
        ReadFrames(options_.frames, edits.firstFrame, edits.lastFrame);
    return edits;
}

bool CShellConversion::WriteEdited(const std::string& path, bool* taken)
{
    const MotionEdits edits = Edits();
    if (edits.firstFrame >= Result().GetKeyCount())
    {
        Notify(MakeNotice(SourcePath(), "no-such-frame",
                          "--frames " + options_.frames + ": the motion has " +
                              std::to_string(Result().GetKeyCount()) + " frames, starting at 0"));
        return false;
    }
    const CEditedMotion edited(Result(), edits);
    if (HasExtension(path, ".bvh") || HasExtension(path, ".glb"))
        return WriteExchange(path, taken);
    return WriteResult(path, taken);
}

bool CShellConversion::Open(const std::string& path)
{
    if (!ReadSource(path) || !LoadTarget())
        return false;
    if (options_.profile.empty())
        PickStockProfile();
    return !notices_.HasFailed();
}

// Uses the draft of the source's skeleton: one that an earlier source got, or a new one if all of its main
// rows are sure.
bool CShellConversion::UseDraft()
{
    constexpr size_t kStemCharacters = 60; // far below the limit of file systems, with the digits behind it
    if (!options_.draft || !m_pkDrafts)
        return false;
    const std::string skeleton = SkeletonDigits(*SourceRoot());
    std::string path = m_pkDrafts->Find(skeleton);
    if (path.empty())
    {
        const SuggestedProfile draft = SuggestProfile(*SourceRoot(), *Result().motionRoot);
        m_kWhyNoDraft = WhyNotSure(draft);
        m_bDraftUnsure = draft.missing.empty() && !m_kWhyNoDraft.empty();
        if (!m_kWhyNoDraft.empty())
            return false;
        const std::string stem = StemOf(SourcePath());
        path = m_pkDrafts->Keep(skeleton, FirstCharacters(stem, kStemCharacters),
                                DraftText(draft, stem, SourceRoot()));
    }
    if (path.empty())
        m_kWhyNoDraft = "the drafted profile cannot be written" + TakeSystemErrorWords();
    m_bDrafted = !path.empty() && UseProfile(path);
    if (const std::optional<Notice> warning = RateWarning(SourcePath(), SourceRoot()); m_bDrafted && warning)
        Notify(*warning);
    return m_bDrafted;
}

// Adds the reason why no draft was used, or the option that allows one.
void CShellConversion::NotifyOfNone(const Notice& notice) const
{
    const std::string source = ShellWord(SourcePath());
    const std::string map = ShellWord(StemOf(SourcePath()) + ".prf");
    Notice full = WithHelp(options_, notice);
    if (!m_kWhyNoDraft.empty())
        full.words += "\n  no draft was used: " + m_kWhyNoDraft;
    else if (!options_.draft)
        full.words += "\n  --draft makes a profile for this skeleton";
    if (!options_.draft || m_bDraftUnsure)
        full.words += "; to check one first: gaitwright suggest " + source + " -o " + map;
    Notify(full);
}

} // namespace gw
