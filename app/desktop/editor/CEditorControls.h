#pragma once

#include <QString>
#include <vector>

class QLabel;
class QLayout;
class QPushButton;
class QWidget;

namespace gw {

class CBoneTreeView;
class CElidedLabel;
class CFieldEdit;
class CGaitConvertContent;
class CMapRowView;
struct ProfileButtons;

/// The children of the editor's window, laid out; what they do is the window's business. They are made from
/// top to bottom, which is the order of the Tab key. Names of objects are control ids.
class CEditorControls
{
public:
    struct Field
    {
        int id;
        CFieldEdit* edit;
    };
    struct Button
    {
        int id;
        bool ProfileButtons::*enabled;
        QPushButton* button;
    };

    /// Fills a window that has no layout yet; it owns what is made. The content names the columns.
    CEditorControls(const CGaitConvertContent& content, QWidget* window);

    std::vector<Field> m_kFields;
    std::vector<Button> m_kButtons;
    QWidget* m_pkFilterLine = nullptr; ///< hidden until somebody looks for a bone
    CFieldEdit* m_pkFilter = nullptr;
    CBoneTreeView* m_pkSourceTree = nullptr;
    CBoneTreeView* m_pkTargetTree = nullptr;
    CElidedLabel* m_pkPair = nullptr; ///< what Add to Map would map
    CMapRowView* m_pkRows = nullptr;

private:
    QLayout* MakeFields();
    QWidget* MakeFilterLine();
    QLayout* MakeTrees();
    CBoneTreeView* MakeTree(int id, const QString& title);
    QLayout* MakePairLine();
    QLayout* MakeRows(const CGaitConvertContent& content);
    QLayout* MakeRowButtons();
    void MakeUnusedControls();
    CFieldEdit* MakeField(int id, const QString& name);
    QPushButton* MakeButton(int id);
    /// A list under its name, with a hint on the right of it or null.
    QLayout* Titled(QWidget* widget, QLabel* hint);
    QLabel* MakeLabel(const QString& text, QWidget* buddy);
    QLabel* MakeHint(const QString& text, const QString& name);

    QWidget* m_pkWindow;
};

} // namespace gw
