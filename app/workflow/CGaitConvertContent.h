#pragma once

#include "CConversion.h"
#include "CMotionFile.h"
#include "CMotionView.h"
#include "COrrinStream.h"
#include "CPlatform.h"
#include "CProfileOwner.h"
#include "CResourceManager.h"
#include "CRetargeter.h"
#include "FileStamp.h"
#include "ResultFile.h"

#include <cstdint>
#include <memory>
#include <optional>
#include <span>
#include <string>
#include <string_view>
#include <vector>

namespace gw {

class CBoneMapProfile;
class CCntComboExControl;
class CContentWindow;
class CProfileEditorDialog;

/// The playbar's last value; the whole motion lies between 0 and this.
inline constexpr int kScrollRange = 256;

/// The conversion from opening a source to saving the result, as a state machine without a window: commands
/// come in by child name, requests go out through the two ports. Operations that answer a number answer 0
/// when they failed and 1 otherwise, also when a dialog was cancelled.
class CGaitConvertContent : public CProfileOwner
{
public:
    /// Both ports must outlive the content.
    CGaitConvertContent(CContentWindow& window, CPlatform& platform);
    ~CGaitConvertContent() override;
    CGaitConvertContent(const CGaitConvertContent&) = delete;
    CGaitConvertContent& operator=(const CGaitConvertContent&) = delete;

    /// Makes the views, the profile list and the profile editor; call it once, before everything else. False
    /// if the window has no view; the rest works without one.
    bool OnInitContent();

    // The workflow

    /// The command of a clicked child. True when the click is to be passed on to the window's own handling.
    bool ChildClick(std::string_view child);
    int OpenSource();
    /// What OpenSource does once a path was chosen: a file of the recent ones, or of the command line.
    int OpenFile(const std::string& path);
    /// What was dropped on the window: a motion opens, a folder offers a batch run, a profile is selected.
    int OpenDropped(const std::string& path);
    int ConvertMotion();
    int SaveResult();
    /// The dialog begins in a folder; an empty one means that of the last source.
    int RunBatch(const std::string& initialFolder = {});
    /// What conversions from now on do beside the rules.
    void SetChoices(const ConversionChoices& choices);
    const ConversionChoices& Choices() const { return m_kChoices; }
    /// The result, written and packaged as the path's extension says. Replaces what is there. False when
    /// nothing was written, or where the package could not be made; what the fixed answers do not tell is
    /// reported.
    bool WriteResult(const std::string& path);
    /// Whether the present result may be dropped; asks when it is not saved.
    bool ConfirmDiscard();
    /// Asks the editor, then for the result: whether the window may close.
    bool MayClose();
    /// Brings the enabled state of every child up to date.
    void UpdateControls();

    // Playback: what the window's timers and its scroll bar deliver

    void OnTimer(int id);
    void ChildMouseDown(std::string_view child);
    void ChildMouseUp(std::string_view child);
    void ChildScroll(std::string_view child, int value);

    // Profiles

    /// A notification of the profile list; code 9 is a choice by hand.
    void OnCntCommand(int code);
    void DeleteSelectedProfile();
    void RefreshProfileList();
    /// Reads the display names of the two stock profiles, by which PickStockProfile selects them.
    void KeepStockNames();
    void PruneProfileList();
    void SelectProfileByName(const std::string& name);
    /// Loads a profile that need not be in the list, as if it had been chosen there.
    void UseProfileFile(const std::string& path);
    void PickStockProfile();

    EAnswer ShowMessage(int id, EButtons buttons, std::span<const int> numbers = {}) override;
    void ProfileStateChanged() override;
    void ProfileSetChanged() override;
    std::string FindProfilePath(const std::string& name) override;
    std::string ProfileFile(const std::string& name) override;
    std::string ExeFile(const std::string& name) override;
    bool RunBoneOffset(CBoneOffsetDialog& dialog) override;

    /// Drafts a profile for the open source, keeps it among the user's and shows it in the editor.
    int DraftProfile();

    // Help

    /// The host product's executable; says so when there is none.
    bool LocateHost(std::string& path);
    /// The host product's help file; true with an empty path when its library names none.
    bool LocateHelp(std::string& path);
    void ShowHelp();

    // What stands

    /// The text of a message; see CResourceManager.
    std::string Message(int id) const;
    /// The window's title: the product's name, and behind it a text if there is one.
    void SetTitle(const std::string& text);
    CBoneMapProfile* Profile() const { return m_pkProfile; }
    /// The sources that were opened last, the newest first.
    std::vector<std::string> RecentFiles() const;
    CProfileEditorDialog* ProfileEditor() const { return m_pkProfileDialog.get(); }
    /// The root of the open source, be it a motion file's or a container's; null when nothing is open.
    CNode* SourceRoot() const;
    const CMotionFile& ResultMotion() const { return m_kResultMotion; }
    bool IsConverted() const { return m_bConverted; }
    bool IsSaved() const { return m_bSaved; }
    const std::string& ProfilePath() const { return m_kProfilePath; }

private:
    struct Command;

    // RecentFiles.cpp
    void AddRecentFile(const std::string& path);

    // CGaitConvertContent.cpp
    int Open(const std::string& path);
    bool LoadSource(const std::string& path);
    bool LoadMotion(CMotionFile& motion, const std::string& path);
    void ShowSource();
    std::string SourceFolder() const;
    void ShowTitle(const std::string& text);
    void RememberFolder(const std::string& path);
    void ForgetFailedSave();
    std::string BaseFile() { return ExeFile(kTargetFile); }
    void Report(const std::string& path, const CFailureRecord& record);

    // ConvertMotion.cpp
    void LoadResult();
    void ReloadResult();
    bool Retarget(bool heedsShift);
    ConversionInput Input() const;
    void ShowProgress(size_t done, size_t total);

    // DraftProfile.cpp
    std::string DraftName() const;
    void OpenDraft(const std::string& name);
    void ReportFindings(const std::string& path);

    // ConvertBatch.cpp
    EBatchStep RunBatchFile(EBatchJob job, const std::string& path, size_t index);
    EBatchStep ConvertFile(const std::string& path, const std::string& output);
    EBatchStep PackageFile(const std::string& path, const std::string& output);
    bool SelectProfileAgain();

    // ControlStates.cpp
    uint32_t ControlFacts() const;
    uint32_t ProfileFacts() const;
    void ShowHighlights();
    void ShowChoices();

    // Commands.cpp
    void ForViews(void (CMotionView::*operation)());
    template <auto Operation>
    void Run();
    template <auto Operation>
    void OnViews();
    template <auto Operation>
    void OnResultView();
    void RequestClose();
    void OpenSourceOrRunBatch();
    void TogglePlay();
    void StopAndRewind();
    void PlayResult();
    void ToggleProfileEditor();

    // ProfileList.cpp
    void AddProfile(const std::string& path, int userData);
    void ChooseProfile();
    void LoadSelectedProfile();
    bool ProfileFits(const std::string& path);
    bool IsListed(const std::string& name) const;

    CContentWindow& window_;
    CPlatform& platform_;
    CResourceManager m_kResources;
    std::unique_ptr<CProfileEditorDialog> m_pkProfileDialog;
    bool m_bSourceIsContainer = false; ///< once set, only a batch conversion clears it
    COrrinStream m_spkSourceScene;     ///< a source read from a container
    CMotionFile m_kSourceMotion;
    std::string m_kSourcePath;             ///< of the file that was opened last
    CMotionFile m_kBaseMotion;             ///< base.htr as it is, for the editor's target tree
    CMotionFile m_kResultMotion;           ///< base.htr again, into which the motion is baked
    std::optional<FileStamp> resultStamp_; ///< of base.htr as read; null once the result was baked or posed
    std::optional<CRetargeter> m_kRetargeter; ///< new for each conversion
    std::unique_ptr<CMotionView> m_pkSourceView;
    std::unique_ptr<CMotionView> m_pkResultView;
    std::string m_kProfilePath;      ///< of the profile selected in the list; empty means none
    std::string m_kPoserProfileName; ///< display name of PoserBVH.prf when the list was last filled
    std::string m_kMaxProfileName;   ///< the same of MaxBVH.prf
    CCntComboExControl* m_pkProfileCombo = nullptr; ///< the profile list, which the window owns
    std::vector<std::string> m_kProfileNames;       ///< every name ever listed; grows with each refresh
    std::string m_kTitle;                           ///< what SetTitle was given last
    ConversionChoices m_kChoices;
    bool m_bConverted = false;              ///< a conversion has been made for the open source
    bool m_bSaved = true;                   ///< the result has been saved, or there was none
    CBoneMapProfile* m_pkProfile = nullptr; ///< the editor's
    CFailureRecord m_kWriteRecord;          ///< what the last WriteResult failed on
};

} // namespace gw
