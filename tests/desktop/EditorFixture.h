#pragma once

#include "CBoneTreeView.h"
#include "CDialogAnswers.h"
#include "CMapRowView.h"
#include "CProfileEditorDialog.h"
#include "CProfileEditorWindow.h"
#include "ContentFixture.h"

#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <functional>
#include <string>
#include <vector>

namespace gw {

/// The editor's window beside a scripted main window: what a person does in it, and what stands in it then.
class EditorTest : public ContentTest
{
protected:
    EditorTest();
    ~EditorTest() override;

    /// Opens a source that the stock profile "Poser" fits, and then the editor.
    void OpenEditor();
    /// Shows or hides the editor as the main window's toggle does.
    void Toggle(bool shown);
    CProfileEditorDialog& Model() const { return *m_kContent.ProfileEditor(); }

    // What the person does
    void Type(int field, const char* text);
    void Press(Qt::Key key, Qt::KeyboardModifiers modifiers = Qt::NoModifier);
    void Click(int button);
    void ClickBone(int tree, const std::string& name);
    void ClickRow(int row, Qt::KeyboardModifiers modifiers = Qt::NoModifier);
    void DoubleClickRow(int row);
    /// What the person will do in the offset dialog once it opens.
    void InOffsetDialog(const std::function<void(QWidget& dialog)>& actions);

    // What the person sees
    template <class Widget>
    Widget& Child(const QString& name) const
    {
        auto* const child = m_kEditor.findChild<Widget*>(name);
        EXPECT_TRUE(child) << name.toStdString();
        return *child;
    }
    template <class Widget>
    Widget& Child(int id) const
    {
        return Child<Widget>(QString::number(id));
    }
    std::string Field(int field) const;
    bool IsEnabled(int button) const;
    /// The names of a tree from the top on, unfolded bones only.
    std::vector<std::string> Bones(int tree) const;
    std::string SelectedBone(int tree) const;
    /// The rows as "hip > LowerTorso 0 0 0"; axes stand behind where they are not neutral.
    std::vector<std::string> Rows() const;
    std::vector<int> SelectedRows() const;

    /// The message boxes since the last time, as "box 157".
    std::vector<std::string> TakeBoxes();

    QWidget m_kOwner; ///< stands for the main window
    CProfileEditorWindow m_kEditor{m_kContent, m_kPlatform, &m_kOwner};
    CDialogAnswers m_kAnswers;
};

/// Lets the window take up what was sent and queued.
void Settle();

} // namespace gw
