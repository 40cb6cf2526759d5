#pragma once

#include "CMotionView.h"
#include "CProfileOwner.h"
#include "CReport.h"

#include <memory>
#include <optional>
#include <string>
#include <string_view>

namespace gw {

class CBoneOffsetDialog;
class CCntComboExControl;

/// What an open or save dialog begins with. A filter is pairs of text and pattern, "|" after each, "||" at
/// the end.
struct FileDialogSetup
{
    std::string defaultExtension; ///< without dot
    std::string filter;
    std::string initialFolder; ///< empty for the system's own choice
};

/// A folder that was chosen, with its trailing separator, and the number of the filter chosen with it, from 1
/// on.
struct FolderChoice
{
    std::string folder;
    int filterIndex = 1;
};

/// The keys whose state is asked for. The left ones only: the right ones have no say.
enum class EKey
{
    LeftCtrl,
    LeftShift,
};

/// The window as the workflow sees it. The desktop window is one implementation, the tests another that
/// answers from a script. Children are known by name. What needs no answer has a body here that does nothing.
class CContentWindow
{
public:
    virtual ~CContentWindow() = default;

    // Questions

    /// Shows a text until it is answered. The id is that of the message.
    virtual EAnswer ShowMessageBox(int id, const std::string& text, EButtons buttons) = 0;
    /// A path, or none when the dialog was cancelled.
    virtual std::optional<std::string> AskOpenFile(const FileDialogSetup& setup) = 0;
    /// The same; the dialog itself asks before a file is replaced.
    virtual std::optional<std::string> AskSaveFile(const FileDialogSetup& setup) = 0;
    virtual std::optional<FolderChoice> AskFolder(const FileDialogSetup& setup) = 0;
    virtual bool IsKeyDown(EKey) const { return false; }

    // Words and progress

    /// Why something failed, or a warning. Comes before the fixed message of the same failure, if it has one.
    virtual void Report(const CReport&) {}
    /// Whether a person looks at what is reported, so that a doubtful file is examined in full.
    virtual bool ShowsFindings() const { return false; }
    /// Whether an operation has run so long that its user should see how far it is.
    virtual bool IsProgressDue() { return false; }
    /// Paints what is due, in the midst of an operation: no key, no click and no timer comes through.
    virtual void StayPainted() {}
    virtual void BeginWaitCursor() {}
    virtual void EndWaitCursor() {}
    /// Draws the window at once, where a dialog has left its mark.
    virtual void RedrawFrame() {}
    virtual void PostCloseRequest() {}

    // Children

    virtual void EnableChild(std::string_view, bool) {}
    /// The picture of a button: 0 as it is, 1 the other one.
    virtual void SetChildFace(std::string_view, int) {}
    virtual void SetChildSecondState(std::string_view, bool) {}
    virtual void SetChildButtonState(std::string_view, bool) {}
    virtual bool GetChildButtonState(std::string_view) const { return false; }
    virtual void SetChildScrollRange(std::string_view, int, int) {}
    virtual void SetChildScrollValue(std::string_view, int) {}
    /// Shows a text at once, also while an operation blocks the window.
    virtual void SetChildText(std::string_view, const std::string&) {}
    /// The view inside an image child, or null where there is none.
    virtual std::unique_ptr<CMotionView> CreateView(std::string_view) { return nullptr; }
    /// Makes the list of profiles on two children, a field and an arrow, with a font size in tenths of a
    /// point. The window owns the list; choices by hand go to OnCntCommand.
    virtual CCntComboExControl& CreateComboEx(std::string_view field, std::string_view arrow,
                                              int fontSize) = 0;
    /// Ticks until it is killed; setting a timer that runs sets its period anew.
    virtual void SetTimer(int, int) {}
    virtual void KillTimer(int) {}

    // The profile editor's dialog, which shows what the editor's model answers

    virtual void ShowProfileEditor(bool) {}
    /// The editor's model changed: rows, trees, fields, buttons or whether it is visible.
    virtual void RefreshProfileEditor() {}
    /// Shows the offset dialog until the user ends it: true on OK.
    virtual bool RunBoneOffset(CBoneOffsetDialog&) { return false; }

    // The desktop around it

    virtual void ShowInFileManager(const std::string&) {}
    /// Opens a topic of a help file: the file's path with the topic behind it.
    virtual void OpenHelpFile(const std::string&) {}
    /// Whether the system took the address.
    virtual bool OpenWebPage(const std::string&) { return false; }
};

} // namespace gw
