#pragma once

#include "CEditorControls.h"

#include <QDialog>
#include <QRect>
#include <optional>

namespace gw {

class CBoneOffsetDialog;
class CPlatform;
class CProfileEditorDialog;

/// The window of the profile editor: shows the model's state and forwards user actions. Modeless; the main
/// window's toggle shows and hides it.
class CProfileEditorWindow : public QDialog
{
public:
    /// Model, texts and questions come from the content; it and the platform must outlive the window.
    CProfileEditorWindow(CGaitConvertContent& content, CPlatform& platform, QWidget* owner);
    ~CProfileEditorWindow() override;

    /// Shows or hides the window. It is placed from the settings the first time and later returns to where it
    /// was hidden; hiding stores its position.
    void SetShown(bool shown);
    /// Schedules an update after the model has changed; several changes share one update.
    void Refresh();
    /// Runs the dialog that edits one row, modal to this window if it is visible, otherwise to the owner.
    /// Returns true on OK.
    bool RunBoneOffset(CBoneOffsetDialog& dialog);
    /// Returns whether this window raised a message, or a file dialog (id 0).
    bool Raised(int messageId) const;

    /// Handles Escape without a search, and the window's close button: commits the field being edited and
    /// closes.
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
    const CEditorControls::Search* FocusedSearch() const;
    void OpenSearch();
    bool AcceptSearch();
    bool ClearSearch();
    void EnterResults();
    void ClickInOwner(const char* child);
    void RestorePlace();
    void Hide();
    void Redraw();
    void ShowTrees();
    void ShowFieldsAndButtons();
    void ShowPair();

    CGaitConvertContent& content_;
    CPlatform& platform_;
    CEditorControls m_kControls;
    /// top left with the frame, size without; the window manager does not remember it
    std::optional<QRect> hiddenAt_;
    bool m_bPlaced = false;
    bool m_bRedrawQueued = false;
    bool m_bLeavingField = false;
    bool m_bClickingInOwner = false; ///< a command of the main window was started here
};

} // namespace gw
