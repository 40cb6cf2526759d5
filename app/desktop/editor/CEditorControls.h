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

/// The controls of the editor's window and their layout; the window handles their events. They are created
/// from top to bottom, which is the Tab order. Object names are control ids.
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

    /// A tree and the field that filters it.
    struct Search
    {
        CFieldEdit* edit;
        CBoneTreeView* tree;
    };

    /// Fills a window that has no layout yet and owns the controls. `content` provides the column names.
    CEditorControls(const CGaitConvertContent& content, QWidget* window);

    std::vector<Field> m_kFields;
    std::vector<Button> m_kButtons;
    std::vector<Search> m_kSearches; ///< source, then target
    CBoneTreeView* m_pkSourceTree = nullptr;
    CBoneTreeView* m_pkTargetTree = nullptr;
    CElidedLabel* m_pkPair = nullptr; ///< the pair that Add to Map would add
    CMapRowView* m_pkRows = nullptr;

private:
    QLayout* MakeFields();
    QLayout* MakeTrees();
    QLayout* MakeTree(int id, const QString& title, CBoneTreeView*& tree);
    CFieldEdit* MakeSearch(int tree, const QString& name);
    QLayout* MakePairLine();
    QLayout* MakeRows(const CGaitConvertContent& content);
    QLayout* MakeRowButtons();
    void MakeUnusedControls();
    CFieldEdit* MakeField(int id, const QString& name);
    QPushButton* MakeButton(int id);
    /// A list under its title, with another widget to the right of the title.
    QLayout* Titled(QWidget* widget, QWidget* beside, int stretch);
    QLabel* MakeLabel(const QString& text, QWidget* buddy);
    QLabel* MakeHint(const QString& text, const QString& name);

    QWidget* m_pkWindow;
};

} // namespace gw
