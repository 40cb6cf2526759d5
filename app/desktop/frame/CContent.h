#pragma once

#include "CContentWindow.h"
#include "CProfileCombo.h"
#include "Notice.h"

#include <QElapsedTimer>
#include <QTimer>
#include <QWidget>
#include <functional>
#include <map>
#include <memory>
#include <vector>

namespace gw {

class CGaitConvertContent;
class CHintPanel;
class CLeftKeys;
class CProfileEditorWindow;
class CSkin;
struct BoxExtras;

/// The face of the main window: the children of a skin. It forwards clicks, drags and ticks to the
/// conversion, which replies through the port that this class implements.
class CContent : public QWidget, public CContentWindow
{
public:
    /// The keys must outlive the content; the skin need not.
    CContent(const CSkin& skin, const CLeftKeys& keys, QWidget* frame);
    ~CContent() override;

    /// Sets the conversion that receives commands; may be null.
    void SetLogic(CGaitConvertContent* logic) { m_pkLogic = logic; }
    void SetEditor(CProfileEditorWindow* editor) { m_pkEditor = editor; }
    /// Returns true during an operation or question, when nothing new can begin.
    bool IsBusy() const;
    /// Frames both motions in their views.
    void FrameAll();

    /// Called when the mouse is pressed on the title.
    std::function<void(const QPoint& globalPosition)> titleDown;
    /// Called when the mouse is pressed in the icon's corner.
    std::function<void(const QPoint& globalPosition)> cornerDown;
    /// Called to open the options menu at a position.
    std::function<void(const QPoint& globalPosition)> options;

    EAnswer ShowMessageBox(int id, const std::string& text, EButtons buttons) override;
    std::optional<std::string> AskOpenFile(const FileDialogSetup& setup) override;
    std::optional<std::string> AskSaveFile(const FileDialogSetup& setup) override;
    std::optional<FolderChoice> AskFolder(const FileDialogSetup& setup) override;
    bool IsKeyDown(EKey key) const override;
    void Notify(const Notice& notice) override;
    bool ShowsFindings() const override { return true; }
    bool IsProgressDue() override;
    void StayPainted() override;
    bool IsCancelRequested() const override { return m_bCancelRequested; }
    void BeginWaitCursor() override;
    void EndWaitCursor() override;
    void RedrawFrame() override;
    void PostCloseRequest() override;
    void EnableChild(std::string_view child, bool on) override;
    void SetChildFace(std::string_view child, int face) override;
    void SetChildButtonState(std::string_view child, bool on) override;
    bool GetChildButtonState(std::string_view child) const override;
    void SetChildScrollRange(std::string_view child, int low, int high) override;
    void SetChildScrollValue(std::string_view child, int value) override;
    void SetChildText(std::string_view child, const std::string& text) override;
    void SetChildTip(std::string_view child, const std::string& text) override;
    void ShowHint(std::string_view child, const Hint& hint) override;
    std::unique_ptr<CMotionView> CreateView(std::string_view child) override;
    CCntComboExControl& CreateComboEx(std::string_view field, std::string_view arrow, int fontSize) override;
    void SetTimer(int id, int milliseconds) override;
    void KillTimer(int id) override;
    void WatchMarks() override;
    void ShowMarks(const MotionMarks& marks) override;
    void ShowProfileEditor(bool visible) override;
    void RefreshProfileEditor() override;
    bool RunBoneOffset(CBoneOffsetDialog& dialog) override;
    void ShowInFileManager(const std::string& path) override;
    void OpenHelpFile(const std::string& path) override;
    bool OpenWebPage(const std::string& address) override;

protected:
    void mousePressEvent(QMouseEvent* event) override;
    void paintEvent(QPaintEvent* event) override;

private:
    template <class Widget>
    Widget* Child(std::string_view name) const;
    void Connect(QWidget& child);
    void ConnectBar(QWidget* child);
    void ConnectMarks();
    void Click(const std::string& child);
    QWidget* Asker(int messageId = 0);
    void ShowNoteCount();
    void ShowNotes();
    void MakeHint(QWidget* view);
    void FocusView();
    void FocusNext();
    void RunSoon(ERemedy remedy);
    EAnswer AskWithOffers(QWidget* asker, const std::string& text, EButtons buttons, const BoxExtras& extras);
    std::string Notes() const;

    const CLeftKeys& keys_;
    CGaitConvertContent* m_pkLogic = nullptr;
    CProfileEditorWindow* m_pkEditor = nullptr;
    std::map<std::string, QWidget*, std::less<>> m_kChildren;
    std::map<int, std::unique_ptr<QTimer>> m_kTimers;
    CProfileCombo m_kCombo;
    std::vector<Notice> m_kNotices; ///< of the current step, or of the last one until the next begins
    QTimer m_kMarksClock;           ///< runs while marks are measured
    QElapsedTimer m_kSincePainted;  ///< during an operation
    std::map<std::string, CHintPanel*, std::less<>> m_kHints; ///< by view
    int m_iWaits = 0;
    bool m_bCancelRequested = false; ///< during an operation
};

} // namespace gw
