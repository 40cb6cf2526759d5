#pragma once

#include "CMotionView.h"
#include "CProfileOwner.h"
#include "Notice.h"
#include "Remedy.h"

#include <memory>
#include <optional>
#include <string>
#include <string_view>

namespace gw {

class CBoneOffsetDialog;
class CCntComboExControl;
struct MotionMarks;

/// The initial state of an open or save dialog. A filter consists of pairs of text and pattern, each followed
/// by "|", with "||" at the end.
struct FileDialogSetup
{
    std::string defaultExtension; ///< without dot
    std::string filter;
    std::string initialFolder;    ///< empty for the system's default
    std::string fileName = {};    ///< proposed name, without folder
    std::string note = {};        ///< text shown in the dialog: what will happen to the files
    std::string moreFilters = {}; ///< appended to the filter
    std::string openedLast = {};  ///< the dialog begins with the first filter that shows such a file
};

/// A selected folder, with trailing separator, and the number of the filter selected with it, starting at 1.
struct FolderChoice
{
    std::string folder;
    int filterIndex = 1;
};

/// The keys that can be queried. Only the left ones; the right ones are ignored.
enum class EKey
{
    LeftCtrl,
    LeftShift,
};

/// The window as seen by the workflow. The desktop window is one implementation; tests use another with
/// scripted answers. Children are identified by name. Functions without a result have an empty default.
class CContentWindow
{
public:
    virtual ~CContentWindow() = default;

    // Questions

    /// Shows a text until it is answered. `id` is the message's.
    virtual EAnswer ShowMessageBox(int id, const std::string& text, EButtons buttons) = 0;
    /// Returns a path, or nothing if the dialog was canceled.
    virtual std::optional<std::string> AskOpenFile(const FileDialogSetup& setup) = 0;
    /// Same for saving; the dialog itself asks before a file is replaced.
    virtual std::optional<std::string> AskSaveFile(const FileDialogSetup& setup) = 0;
    virtual std::optional<FolderChoice> AskFolder(const FileDialogSetup& setup) = 0;
    virtual bool IsKeyDown(EKey) const { return false; }

    // Messages and progress

    /// Reports a failure or warning. Called before the fixed message of the same failure, if it has one.
    virtual void Notify(const Notice&) {}
    /// Returns whether a person sees the notices, so that a doubtful file is examined in full.
    virtual bool ShowsFindings() const { return false; }
    /// Returns whether an operation has taken long enough to show its progress.
    virtual bool IsProgressDue() { return false; }
    /// Returns whether the user has asked, since the operation began, to end it without a result.
    virtual bool IsCancelRequested() const { return false; }
    /// Repaints during an operation, without handling keys, clicks or timers.
    virtual void StayPainted() {}
    virtual void BeginWaitCursor() {}
    virtual void EndWaitCursor() {}
    /// Redraws the window immediately, after a dialog has covered it.
    virtual void RedrawFrame() {}
    virtual void PostCloseRequest() {}

    // Children

    virtual void EnableChild(std::string_view, bool) {}
    /// Sets the picture of a button: 0 for the normal one, 1 for the other.
    virtual void SetChildFace(std::string_view, int) {}
    virtual void SetChildSecondState(std::string_view, bool) {}
    virtual void SetChildButtonState(std::string_view, bool) {}
    virtual bool GetChildButtonState(std::string_view) const { return false; }
    virtual void SetChildScrollRange(std::string_view, int, int) {}
    virtual void SetChildScrollValue(std::string_view, int) {}
    /// Shows a text immediately, even while an operation blocks the window.
    virtual void SetChildText(std::string_view, const std::string&) {}
    /// Sets a child's tool tip.
    virtual void SetChildTip(std::string_view, const std::string&) {}
    /// Shows text and buttons in the middle of an empty image child; removes them if the text is empty. A
    /// click on a button goes to RunRemedy.
    virtual void ShowHint(std::string_view, const Hint&) {}
    /// Creates the view inside an image child; null if it has none.
    virtual std::unique_ptr<CMotionView> CreateView(std::string_view) { return nullptr; }
    /// Creates the list of profiles on two children, a field and an arrow, with a font size in tenths of a
    /// point. The window owns the list; choices by the user go to OnCntCommand.
    virtual CCntComboExControl& CreateComboEx(std::string_view field, std::string_view arrow,
                                              int fontSize) = 0;
    /// Starts a timer that runs until it is killed; a running timer gets the new period.
    virtual void SetTimer(int, int) {}
    virtual void KillTimer(int) {}

    // Marks under the bar

    /// Marks are being measured: call UpdateMarks from time to time until it returns false.
    virtual void WatchMarks() {}
    /// Replaces the marks on display; none if their frame count is 0.
    virtual void ShowMarks(const MotionMarks&) {}

    // The profile editor's dialog, which displays the editor's model

    virtual void ShowProfileEditor(bool) {}
    /// The editor's model has changed: rows, trees, fields, buttons or visibility.
    virtual void RefreshProfileEditor() {}
    /// Shows the offset dialog until the user ends it; returns true on OK.
    virtual bool RunBoneOffset(CBoneOffsetDialog&) { return false; }

    // The desktop environment

    virtual void ShowInFileManager(const std::string&) {}
    /// Opens a topic of a help file: the path followed by the topic.
    virtual void OpenHelpFile(const std::string&) {}
    /// Returns whether the system accepted the address.
    virtual bool OpenWebPage(const std::string&) { return false; }
};

} // namespace gw
