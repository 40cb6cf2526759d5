#pragma once

#include "CBoneTreeView.h"
#include "CDialogAnswers.h"
#include "CMapRowView.h"
#include "CProfileEditorDialog.h"
#include "CProfileEditorWindow.h"
#include "ContentFixture.h"
#include "Widgets.h"

#include <QLabel>
#include <QPushButton>
#include <functional>
#include <string>
#include <vector>

namespace gw {

/// The editor's window with a scripted main window: user actions, and the visible state.
class EditorTest : public ContentTest
{
protected:
    EditorTest();
    ~EditorTest() override;

    /// Opens a source that fits the stock profile "Poser", then the editor.
    void OpenEditor();
    /// Shows or hides the editor as the main window's toggle does.
    void Toggle(bool shown);
    CProfileEditorDialog& Model() const { return *m_kContent.ProfileEditor(); }

    // User actions
    void Type(int field, const char* text);
    void Press(Qt::Key key, Qt::KeyboardModifiers modifiers = Qt::NoModifier);
    void Click(int button);
    void ClickBone(int tree, const std::string& name);
    void ClickRow(int row, Qt::KeyboardModifiers modifiers = Qt::NoModifier);
    void DoubleClickRow(int row);
    /// Sets the actions in the offset dialog, once it opens.
    void InOffsetDialog(const std::function<void(QWidget& dialog)>& actions);

    // Visible state
    template <class Widget>
    Widget& Child(const QString& name) const
    {
        return ChildOf<Widget>(m_kEditor, name);
    }
    template <class Widget>
    Widget& Child(int id) const
    {
        return ChildOf<Widget>(m_kEditor, QString::number(id));
    }
    std::string Field(int field) const;
    bool IsEnabled(int button) const;
    /// Returns the names of a tree from top to bottom, expanded bones only.
    std::vector<std::string> Bones(int tree) const;
    std::string SelectedBone(int tree) const;
    /// Returns the rows as "hip > LowerTorso 0 0 0", followed by the axes unless they are neutral.
    std::vector<std::string> Rows() const;
    std::vector<int> SelectedRows() const;

    QWidget m_kOwner; ///< in place of the main window
    CProfileEditorWindow m_kEditor{m_kContent, m_kPlatform, &m_kOwner};
    CDialogAnswers m_kAnswers;
};

/// Lets the window handle everything that was sent and queued.
void Settle();

} // namespace gw
