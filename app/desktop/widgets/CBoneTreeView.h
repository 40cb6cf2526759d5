#pragma once

#include "CBoneTree.h"

#include <QTreeWidget>
#include <functional>
#include <string>
#include <vector>

namespace gw {

/// A tree of bones on the screen. Knows what it shows, so that a tree that only changed
/// its markers or its selection is not built again: scroll position and folded bones stay.
class CBoneTreeView : public QTreeWidget
{
public:
    explicit CBoneTreeView(QWidget* parent);

    /// Tells of the item that the user selected, or kNone.
    void SetOnSelect(std::function<void(int item)> onSelect) { onSelect_ = std::move(onSelect); }
    /// Shows a tree as it stands: all of it for an empty filter, else a flat list of the bones that the
    /// filter finds.
    void ShowTree(const CBoneTree& tree, const std::string& filter);

protected:
    void selectionChanged(const QItemSelection& selected, const QItemSelection& deselected) override;

private:
    struct Bone
    {
        std::string m_kText;
        int m_iParent = CBoneTree::kNone;
        bool m_bMapped = false;
        bool m_bFolded = false;
        QTreeWidgetItem* m_pkItem = nullptr; ///< null while the filter hides it
    };

    bool HasBonesOf(const CBoneTree& tree) const;
    void TakeBones(const CBoneTree& tree);
    void Build(const CBoneTree& tree);
    QTreeWidgetItem* MakeItem(const CBoneTree& tree, int item);
    void ShowMarkers(const CBoneTree& tree);
    void ShowMarker(const CBoneTree& tree, int item);
    void ShowSelection(const CBoneTree& tree);
    void NoteFolding(const QTreeWidgetItem* item, bool folded);
    bool IsFlat() const { return !m_kFilter.empty(); }
    Bone& BoneOf(int item) { return m_kBones[static_cast<size_t>(item)]; }

    std::function<void(int item)> onSelect_ = [](int) {};
    std::vector<Bone> m_kBones; ///< by the tree's items
    std::vector<int> m_kOrder;  ///< the items that are shown, from the top on
    std::string m_kFilter;
    bool m_bShowing = false; ///< changes come from the tree and not from the user
};

} // namespace gw
