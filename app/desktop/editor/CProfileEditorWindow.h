#pragma once

#include "CEditorControls.h"

#include <QDialog>
#include <QRect>
#include <optional>

namespace gw {

class CBoneOffsetDialog;
class CPlatform;
class CProfileEditorDialog;

/// The window of the profile editor: shows what the model answers, forwards what the user does. Modeless; the
/// main window's toggle shows and hides it.
class CProfileEditorWindow : public QDialog
{
public:
    /// Model, texts and questions are the content's; both it and the platform must outlive the window.
    CProfileEditorWindow(CGaitConvertContent& content, CPlatform& platform, QWidget* owner);
    ~CProfileEditorWindow() override;

    /// Shows or hides the window as the model says. It is placed from the settings the first time, and later
    /// comes back where it was hidden; hiding it stores its place.
    void SetShown(bool shown);
    /// The model changed: shows its present state soon, all changes until then at once.
    void Refresh();
    /// Runs the dialog that edits one row, modal to this window if it is visible, else to the owner. True on
    /// OK.
    bool RunBoneOffset(CBoneOffsetDialog& dialog);

    /// Escape, and the window's own close button: commits the field that is being edited and closes.
    void reject() override;

protected:
    void keyPressEvent(QKeyEvent* event) override;

private:
    void ConnectFields();
    void ConnectTrees();
    void ConnectRows();
    void ConnectButtons();
    void AddShortcuts();
    CProfileEditorDialog& Model() const;
    void LeaveField();
    void ReleaseButtons();
    void OpenFilter();
    void CloseFilter();
    void RestorePlace();
    void Hide();
    void Redraw();
    void ShowTrees();
    void ShowFieldsAndButtons();
    void ShowPair();

    CGaitConvertContent& content_;
    CPlatform& platform_;
    CEditorControls m_kControls;
    std::optional<QRect> hiddenAt_; ///< top left with the frame, size without; the window manager forgets it
    bool m_bPlaced = false;
    bool m_bRedrawQueued = false;
    bool m_bLeavingField = false;
};

} // namespace gw
