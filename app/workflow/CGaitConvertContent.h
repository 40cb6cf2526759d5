#pragma once

#include "CConversion.h"
#include "CMarksMeter.h"
#include "CMotionFile.h"
#include "CMotionView.h"
#include "CNextSteps.h"
#include "COrrinStream.h"
#include "CPlatform.h"
#include "CProfileOwner.h"
#include "CResourceManager.h"
#include "CRetargeter.h"
#include "Captions.h"
#include "FileStamp.h"
#include "Notice.h"
#include "Remedy.h"
#include "ResultFile.h"

#include <cstdint>
#include <functional>
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

/// The playbar's last value; 0 to this value covers the whole motion.
inline constexpr int kScrollRange = 256;
/// The period of the clock that advances both views by one frame.
inline constexpr int kClockMilliseconds = 17;

/// The children that show the motions.
inline constexpr const char* kSourceViewChild = "#cnt1";
inline constexpr const char* kResultViewChild = "#cnt2";

/// The conversion from opening a source to saving the result, as a state machine without a window: commands
/// arrive by child name, requests go out through the two ports. Operations that return a number return 0 on
/// failure and 1 otherwise, also if a dialog was canceled.
class CGaitConvertContent : public CProfileOwner
{
public:
    /// Both ports must outlive the content.
    CGaitConvertContent(CContentWindow& window, CPlatform& platform);
    ~CGaitConvertContent() override;
    CGaitConvertContent(const CGaitConvertContent&) = delete;
    CGaitConvertContent& operator=(const CGaitConvertContent&) = delete;

    /// Creates the views, the profile list and the profile editor. Call it once, before everything else.
    /// Returns false if the window has no view; the rest works without one.
    bool OnInitContent();

    // The workflow

    /// Runs the command of a clicked child. Returns true if the window should handle the click as well.
    bool ChildClick(std::string_view child);
    int OpenSource();
    /// Opens a path like OpenSource after the dialog: a recent file, or one from the command line.
    int OpenFile(const std::string& path);
    /// Returns the names of the clips in the open source; none for formats without clips.
    const std::vector<std::string>& Clips() const;
    /// Returns the one that is open.
    const std::string& OpenClip() const { return m_kSourceMotion.imported.clip; }
    /// Opens another clip of the open source.
    int ChooseClip(const std::string& clip);
    /// Handles a drop on the window: opens a motion, offers a batch run for a folder, selects a profile.
    int OpenDropped(const std::string& path);
    int ConvertMotion();
    int SaveResult();
    /// The dialog starts in a folder; empty means the last source's.
    int RunBatch(const std::string& initialFolder = {});
    /// Sets the options of future conversions.
    void SetChoices(const ConversionChoices& choices);
    const ConversionChoices& Choices() const { return m_kChoices; }
    /// Writes the result, packaged if the extension is .Kinetra, replacing an existing file. Returns false if
    /// nothing was written or packaging failed; details that the fixed messages do not contain are reported.
    bool WriteResult(const std::string& path);
    /// Returns whether the current result may be discarded; asks if it is not saved.
    bool ConfirmDiscard();
    /// Asks the editor and then about the result; returns whether the window may close.
    bool MayClose();
    /// Updates the enabled state of every child.
    void UpdateControls();

    // Playback: events from the window's timers and its scroll bar

    void OnTimer(int id);
    void ChildMouseDown(std::string_view child);
    void ChildMouseUp(std::string_view child);
    void ChildScroll(std::string_view child, int value);

    // The views

    /// Keeps the figures in the middle of both views, or not, and remembers that in the settings.
    void SetFollow(bool on);
    bool IsFollowing() const { return m_bFollows; }
    /// Selects the bone that was clicked in a view, in the editor's tree.
    void ClickBone(std::string_view child, const std::string& bone);

    // Marks: planted feet and worst frames of the result, which are measured after each conversion

    /// Shows the marks in the window if they are measured by now. Returns whether that is still going on.
    bool UpdateMarks();
    const MotionMarks& Marks() const { return m_kMarks; }
    /// Stops at a frame of the source, and at the same moment of the result.
    void GoToFrame(int frame);
    /// Stops at the next of the worst frames; after the last one, at the first.
    void GoToNextWorst();

    // Profiles

    /// Handles a notification of the profile list; code 9 is a choice by the user.
    void OnCntCommand(int code);
    void DeleteSelectedProfile();
    void RefreshProfileList();
    /// Reads the display names of the two stock profiles, which PickStockProfile uses.
    void KeepStockNames();
    void PruneProfileList();
    void SelectProfileByName(const std::string& name);
    /// Loads a profile that need not be in the list, as if it had been selected there.
    void UseProfileFile(const std::string& path);
    void PickStockProfile();

    EAnswer ShowMessage(int id, EButtons buttons, std::span<const int> numbers = {}) override;
    void ProfileStateChanged() override;
    void ProfileSetChanged() override;
    std::string FindProfilePath(const std::string& name) override;
    std::string ProfileFile(const std::string& name) override;
    std::string ExeFile(const std::string& name) override;
    bool RunBoneOffset(CBoneOffsetDialog& dialog) override;

    /// Drafts a profile for the open source, saves it with the user's and shows it in the editor.
    int DraftProfile();

    // Next steps

    /// Runs a remedy that was offered.
    void RunRemedy(ERemedy remedy);
    /// Runs the first remedy that the result's view offers, if any.
    void TakeOffer();
    /// Returns the remedies for the notices of a step.
    std::vector<Offer> OffersFor(std::span<const Notice> notices) const;

    // Help

    /// Finds the host product's executable; shows a message if it is not installed.
    bool LocateHost(std::string& path);
    /// Finds the host product's help file; returns true with an empty path if its library names none.
    bool LocateHelp(std::string& path);
    void ShowHelp();

    // State

    /// Returns the text of a message; see CResourceManager.
    std::string Message(int id) const;
    /// Sets the window's title: the product's name, followed by `text` unless it is empty.
    void SetTitle(const std::string& text);
    CBoneMapProfile* Profile() const { return m_pkProfile; }
    /// Returns the recently opened sources, newest first.
    std::vector<std::string> RecentFiles() const;
    void ClearRecentFiles();
    CProfileEditorDialog* ProfileEditor() const { return m_pkProfileDialog.get(); }
    /// Returns the root of the open source, motion file or container; null if nothing is open.
    CNode* SourceRoot() const;
    const CMotionFile& ResultMotion() const { return m_kResultMotion; }
    bool IsConverted() const { return m_bConverted; }
    bool IsSaved() const { return m_bSaved; }
    const std::string& ProfilePath() const { return m_kProfilePath; }

private:
    struct Command;
    class CLongStep;

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
    void Notify(const std::string& path, const CFailureRecord& record);

    // ConvertMotion.cpp
    void LoadResult();
    void ReloadResult();
    bool Retarget(bool heedsShift);
    ConversionInput Input() const;
    SourceTiming Timing() const;
    void PutBackResult(const CMotionFile& before);

    // LongStep.cpp
    std::function<void(size_t, size_t)> ProgressOf(const char* verb);
    void ShowProgress(const char* verb, size_t done, size_t total);

    // DraftProfile.cpp
    std::string DraftName() const;
    void OpenDraft(const std::string& name);
    std::string FreeName(const std::string& name) const;
    void NotifyOfFindings(const std::string& path);
    void OpenMendedCopy();
    void UseSureMap();

    // Offers.cpp
    void NotifyOfPose();
    void NotifyOfUpAxis();
    void MeasureFits();
    void SortProfileList();
    std::string MapName() const;
    void UseBestMap();
    std::string SaveAdapted(const ProfileChoice& choice);
    bool SaveNewMap(const std::string& path, const std::string& text);
    StepState State() const;

    // Hints.cpp
    void ShowCaptions();
    std::string SourceNote() const;
    bool HasChangedSince() const;

    // ConvertBatch.cpp
    std::string BatchNote() const;
    EBatchStep RunBatchFile(EBatchJob job, const std::string& path, size_t index);
    EBatchStep ConvertFile(const std::string& path, const std::string& output);
    EBatchStep PackageFile(const std::string& path, const std::string& output);
    bool SelectProfileAgain();

    // ControlStates.cpp
    uint32_t ControlFacts() const;
    uint32_t ProfileFacts() const;
    void ShowHighlights();
    void ShowChoices();

    // ViewCommands.cpp
    void RestoreFollow();

    // Marks.cpp
    void StartMarks(CNode& driving);
    void ClearMarks();
    void ShowWorstFrame();

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
    std::string m_kSourcePath;             ///< of the last opened file
    CMotionFile m_kBaseMotion;             ///< base.htr unchanged, for the editor's target tree
    CMotionFile m_kResultMotion;           ///< base.htr again, into which the motion is baked
    std::optional<FileStamp> resultStamp_; ///< of base.htr when read; null once the result was baked or posed
    std::optional<CRetargeter> m_kRetargeter; ///< new for each conversion
    std::unique_ptr<CMotionView> m_pkSourceView;
    std::unique_ptr<CMotionView> m_pkResultView;
    std::string m_kProfilePath;      ///< of the selected profile; empty if none
    std::string m_kPoserProfileName; ///< display name of PoserBVH.prf when the list was last filled
    std::string m_kMaxProfileName;   ///< same for MaxBVH.prf
    CCntComboExControl* m_pkProfileCombo = nullptr; ///< the profile list, owned by the window
    std::vector<std::string> m_kProfileNames;       ///< every name ever listed; grows with each refresh
    std::string m_kTitle;                           ///< last text passed to SetTitle
    ConversionChoices m_kChoices;
    bool m_bFollows = false; ///< both views keep the figure in the middle
    CNextSteps m_kNextSteps;
    std::string m_kSavedPath;               ///< of the open source's last saved result
    std::string m_kResultFile;              ///< the file with the result; empty if it is not saved
    std::optional<ResultOrigin> m_kOrigin;  ///< of the result in its view; null if the view is empty
    bool m_bConversionFailed = false;       ///< the last conversion of the open source
    bool m_bCancelable = false;             ///< the user may cancel the long step that is running
    bool m_bProgressShown = false;          ///< the title shows the progress of a long step
    bool m_bConverted = false;              ///< the open source has been converted
    bool m_bSaved = true;                   ///< the result has been saved, or there is none
    CBoneMapProfile* m_pkProfile = nullptr; ///< the editor's
    MotionMarks m_kMarks;                   ///< of the result, once they are measured
    CMarksMeter m_kMarksMeter;
    CFailureRecord m_kWriteRecord; ///< failures of the last WriteResult
};

} // namespace gw
