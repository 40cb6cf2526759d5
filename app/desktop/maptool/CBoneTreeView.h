#pragma once

#include <QTreeWidget>
#include <functional>
#include <vector>

namespace gw {

class CBoneTree;

/// Shows a tree of bones with a mark before each: a full dot for a mapped bone, a ring for another.
class CBoneTreeView : public QTreeWidget
{
public:
    explicit CBoneTreeView(QWidget* parent);

    /// Called with the item that the user selects.
    void SetSelected(std::function<void(int item)> selected) { m_kSelected = std::move(selected); }
    /// Shows the tree as it stands. Items stay, and with them what the user has folded, while the bones are
    /// the same.
    void Show(const CBoneTree& tree);

private:
    bool ShowsBonesOf(const CBoneTree& tree) const;
    void Rebuild(const CBoneTree& tree);
    void ShowMarks(const CBoneTree& tree);
    void ShowSelection(const CBoneTree& tree);

    std::vector<QTreeWidgetItem*> m_kItems; // as the tree numbers them
    std::function<void(int)> m_kSelected;
};

} // namespace gw
