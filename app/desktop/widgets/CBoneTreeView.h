#pragma once

#include "CBoneTree.h"

#include <QTreeWidget>
#include <functional>
#include <string>
#include <vector>

namespace gw {

/// A tree of bones on the screen. It remembers what it shows, so that a tree in which only markers or
/// selection changed is not rebuilt: scroll position and collapsed bones are kept.
class CBoneTreeView : public QTreeWidget
{
public:
    explicit CBoneTreeView(QWidget* parent);

    /// Called with the item that the user selected, or kNone.
    void SetOnSelect(std::function<void(int item)> onSelect) { onSelect_ = std::move(onSelect); }
    /// Shows a tree: completely if the filter is empty, otherwise a flat list of the matching bones.
    void ShowTree(const CBoneTree& tree, const std::string& filter);
    /// Selects the bone at the top, as if the user had. Returns false if no bone is visible.
    bool SelectFirst();

protected:
    void selectionChanged(const QItemSelection& selected, const QItemSelection& deselected) override;

private:
    struct Bone
    {
        std::string m_kText;
        int m_iParent = CBoneTree::kNone;
        bool m_bMapped = false;
        bool m_bFolded = false;
        QTreeWidgetItem* m_pkItem = nullptr; ///< null if the filter hides it
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
    std::vector<Bone> m_kBones; ///< indexed by the tree's items
    std::vector<int> m_kOrder;  ///< visible items from top to bottom
    std::string m_kFilter;
    bool m_bShowing = false; ///< changes come from the tree, not the user
};

} // namespace gw
