#pragma once

#include "CCntComboExControl.h"
#include "CContentWindow.h"
#include "CGLView.h"
#include "CGaitConvertContent.h"
#include "CPlatform.h"
#include "MotionMarks.h"
#include "SystemConventions.h"
#include "TempFolder.h"

#include <algorithm>
#include <array>
#include <functional>
#include <gtest/gtest.h>
#include <map>
#include <set>
#include <string>
#include <vector>

namespace gw {

/// Returns a path with slashes in place of the system's separators.
inline std::string WithSlashes(std::string path)
{
    std::ranges::replace(path, kPathSeparator, '/');
    return path;
}

/// A view that records what it shows.
class CWatchedView : public CGLView
{
public:
    void SetScene(CNode* root, float frameStep, float lastFrame) override
    {
        m_spkShown = root;
        CGLView::SetScene(root, frameStep, lastFrame);
    }

    Ref<CNode> m_spkShown;
};

/// A window with scripted answers that records what it was asked.
class CScriptedWindow : public CContentWindow
{
public:
    EAnswer ShowMessageBox(int id, const std::string& text, EButtons buttons) override;
    std::optional<std::string> AskOpenFile(const FileDialogSetup& setup) override;
    std::optional<std::string> AskSaveFile(const FileDialogSetup& setup) override;
    std::optional<FolderChoice> AskFolder(const FileDialogSetup& setup) override;
    bool IsKeyDown(EKey key) const override { return m_kKeys.contains(key); }
    void Notify(const Notice& notice) override;
    bool ShowsFindings() const override { return m_bShowsFindings; }
    void StayPainted() override { onPaint(); }
    bool IsProgressDue() override { return m_bProgressDue; }
    bool IsCancelRequested() const override { return m_bCancel; }
    void BeginWaitCursor() override { ++m_iWaits; }
    void EndWaitCursor() override { --m_iWaits; }
    void PostCloseRequest() override { m_kCalls.emplace_back("close"); }
    void EnableChild(std::string_view child, bool on) override { m_kEnabled[std::string(child)] = on; }
    void SetChildFace(std::string_view child, int face) override
    {
        m_iPlayFace = child == "play" ? face : m_iPlayFace;
    }
    void SetChildButtonState(std::string_view, bool on) override { m_bButtonState = on; }
    bool GetChildButtonState(std::string_view) const override { return m_bButtonState; }
    void SetChildScrollValue(std::string_view, int value) override { m_iScrollValue = value; }
    void SetChildText(std::string_view child, const std::string& text) override;
    void ShowHint(std::string_view child, const Hint& hint) override { m_kHints[std::string(child)] = hint; }
    void ShowMarks(const MotionMarks& marks) override { m_iMarkedFrames = marks.frameCount; }
    std::unique_ptr<CMotionView> CreateView(std::string_view child) override;
    CCntComboExControl& CreateComboEx(std::string_view, std::string_view, int) override { return m_kList; }
    void SetTimer(int id, int milliseconds) override;
    void KillTimer(int id) override { m_kCalls.push_back("kill " + std::to_string(id)); }
    void ShowInFileManager(const std::string& path) override { m_kCalls.push_back("show " + path); }
    void OpenHelpFile(const std::string& path) override { m_kCalls.push_back("help " + path); }
    bool OpenWebPage(const std::string& address) override;
    void ShowProfileEditor(bool shown) override { onShowEditor(shown); }
    void RefreshProfileEditor() override { onRefreshEditor(); }
    bool RunBoneOffset(CBoneOffsetDialog& dialog) override { return onBoneOffset(dialog); }

    /// Returns the enabled children, separated by blanks, in any order.
    std::set<std::string> Enabled() const;
    /// Returns the calls since the last time.
    std::vector<std::string> TakeCalls() { return std::exchange(m_kCalls, {}); }
    /// Returns only the notices and message boxes: "not-found, 138".
    std::string TakeWords();

    std::optional<std::string> openAnswer;
    std::optional<std::string> saveAnswer;
    std::optional<FolderChoice> folderAnswer;
    std::map<int, EAnswer> m_kAnswers; ///< by message; others are answered with OK
    std::set<EKey> m_kKeys;
    std::function<void()> onPaint = [] {}; ///< runs during an operation
    std::function<void()> onBox = [] {};   ///< runs while a message box is open
    std::function<void(bool shown)> onShowEditor = [](bool) {};
    std::function<void()> onRefreshEditor = [] {};
    std::function<bool(CBoneOffsetDialog& dialog)> onBoneOffset = [](CBoneOffsetDialog&) { return false; };
    CProfileList m_kList;
    std::map<std::string, bool> m_kEnabled;
    std::vector<Notice> m_kNotices; ///< also among the calls, as "notice CODE NAME"
    std::vector<std::string> m_kTitles;
    std::vector<std::string> m_kBoxes; ///< texts of the message boxes
    std::vector<std::string> m_kCalls;
    CWatchedView* m_pkSource = nullptr;
    CWatchedView* m_pkResult = nullptr;
    int m_iWaits = 0;
    int m_iPlayFace = 0;
    int m_iScrollValue = 0;
    bool m_bButtonState = false;
    bool m_bProgressDue = false;
    bool m_bCancel = false;
    bool m_bShowsFindings = false;
    FileDialogSetup m_kAsked;                    ///< of the last file or folder dialog
    std::map<std::string, std::string> m_kTexts; ///< last texts of children, by name
    std::map<std::string, Hint> m_kHints;        ///< same for hints
    int m_iMarkedFrames = 0;
};

/// Settings in memory, and folders data/ and docs/ in a temporary folder.
class CScriptedPlatform : public CPlatform
{
public:
    explicit CScriptedPlatform(const CTempFolder& folder) : m_kFolder(folder) {}

    std::string ReadSetting(const std::string& key) const override;
    bool WriteSetting(const std::string& key, const std::string& value) override;
    std::string ReadHostKey(const std::string& keyPath, const std::string& valueName) const override;
    std::string DocumentsFolder() const override { return m_kFolder.Path("docs"); }
    std::string DataFolder() const override { return m_kFolder.Path("data/"); }
    bool MakeFolder(const std::string& path) override;
    uint32_t ThreadLocale() const override { return m_uiLocale; }

    std::map<std::string, std::string> m_kSettings;
    std::map<std::string, std::string> m_kHostKeys; ///< by "path/name"
    uint32_t m_uiLocale = 1033;

private:
    const CTempFolder& m_kFolder;
};

/// Returns the words of a text as a set.
std::set<std::string> Words(std::string_view text);

/// The bones of a source skeleton: the hip, then each leg from thigh to foot, left before right.
using SourceBones = std::array<std::string, 7>;
extern const SourceBones kPoserBones;
extern const SourceBones kMaxBones;

/// Returns a BVH file that walks on the spot; a profile that fits it exists.
std::string BvhText(const SourceBones& bones, int frameCount = 3);
std::string BoneMapText(const std::string& name, const SourceBones& bones);

/// The state machine with a target skeleton, two stock profiles and a custom one, between a scripted window
/// and a scripted platform.
class ContentTest : public testing::Test
{
protected:
    ContentTest();

    /// Writes a file into the temporary folder and returns its path.
    std::string Write(const std::string& name, const std::string& text) const;
    std::string Read(const std::string& name) const;
    bool Exists(const std::string& name) const;
    /// Writes a container with the given node and track names, and returns its path.
    std::string WriteContainer(const std::string& name, bool withTrack = true) const;

    int Open(const std::string& path);
    /// Performs user actions in order: "open walk.bvh, click play, select Mine".
    void Do(std::string_view steps);
    /// Opens a source and converts it with the stock profile that fits.
    void OpenAndConvert();
    int SaveAs(const std::string& name);
    void SelectProfile(const std::string& name);
    std::string SelectedProfile() const;

    CTempFolder m_kFolder;
    CScriptedPlatform m_kPlatform{m_kFolder};
    CScriptedWindow m_kWindow;
    CGaitConvertContent m_kContent{m_kWindow, m_kPlatform};
};

} // namespace gw
