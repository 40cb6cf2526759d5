// Shows a bone tree. A tree with the same names is updated in place; only other names rebuild the items.

#include "CBoneTreeView.h"

#include "BoneMarker.h"
#include "FilterBones.h"
#include "QtText.h"

#include <QScopedValueRollback>
#include <QScrollBar>
#include <algorithm>
#include <numeric>

namespace gw {

namespace {

constexpr int kItemRole = Qt::UserRole;

int ItemOf(const QTreeWidgetItem* item)
{
    return item ? item->data(0, kItemRole).toInt() : CBoneTree::kNone;
}

std::vector<int> AllItems(const CBoneTree& tree)
{
    std::vector<int> items(tree.Items().size());
    std::iota(items.begin(), items.end(), 0);
    return items;
}

} // namespace

CBoneTreeView::CBoneTreeView(QWidget* parent) : QTreeWidget(parent)
{
    setHeaderHidden(true);
    setUniformRowHeights(true); // avoids measuring every row of a large tree
    setTextElideMode(Qt::ElideMiddle);
    connect(this, &QTreeWidget::itemCollapsed, this,
            [this](const QTreeWidgetItem* item) { NoteFolding(item, true); });
    connect(this, &QTreeWidget::itemExpanded, this,
            [this](const QTreeWidgetItem* item) { NoteFolding(item, false); });
}

void CBoneTreeView::ShowTree(const CBoneTree& tree, const std::string& filter)
{
    const QScopedValueRollback showing(m_bShowing, true);
    std::vector<int> order = filter.empty() ? AllItems(tree) : FilterBones(tree, filter);
    const bool sameBones = HasBonesOf(tree);
    const bool sameList = sameBones && filter == m_kFilter;
    if (!sameBones)
        TakeBones(tree);
    if (sameList && order == m_kOrder)
    {
        ShowMarkers(tree);
        ShowSelection(tree);
        return;
    }
    const int scroll = verticalScrollBar()->value();
    m_kOrder = std::move(order);
    m_kFilter = filter;
    Build(tree);
    ShowSelection(tree);
    if (sameList) // a bone that moved within the list does not move its children
        verticalScrollBar()->setValue(scroll);
}

bool CBoneTreeView::HasBonesOf(const CBoneTree& tree) const
{
    const auto same = [](const Bone& bone, const CBoneTree::Item& item) {
        return bone.m_kText == item.m_kText && bone.m_iParent == item.m_iParent;
    };
    return std::ranges::equal(m_kBones, tree.Items(), same);
}

void CBoneTreeView::TakeBones(const CBoneTree& tree)
{
    m_kBones.clear();
    for (const CBoneTree::Item& item : tree.Items())
        m_kBones.push_back({item.m_kText, item.m_iParent});
}

// Builds all items first and adds them in one step, so that the widget lays them out only once.
void CBoneTreeView::Build(const CBoneTree& tree)
{
    clear();
    for (Bone& bone : m_kBones)
        bone.m_pkItem = nullptr;
    QList<QTreeWidgetItem*> top;
    for (const int item : m_kOrder)
    {
        const int parent = IsFlat() ? CBoneTree::kNone : BoneOf(item).m_iParent;
        QTreeWidgetItem* const made = MakeItem(tree, item);
        if (parent == CBoneTree::kNone)
            top.push_back(made);
        else
            BoneOf(parent).m_pkItem->addChild(made); // parents come before their children
    }
    setRootIsDecorated(!IsFlat());
    addTopLevelItems(top);
    for (const int item : m_kOrder)
        BoneOf(item).m_pkItem->setExpanded(!BoneOf(item).m_bFolded);
    executeDelayedItemsLayout();
}

QTreeWidgetItem* CBoneTreeView::MakeItem(const CBoneTree& tree, int item)
{
    auto* const made = new QTreeWidgetItem;
    made->setText(0, ToQString(tree.Text(item)));
    made->setData(0, kItemRole, item);
    if (IsFlat())
        made->setToolTip(0, ToQString(BonePath(tree, item)));
    BoneOf(item).m_pkItem = made;
    ShowMarker(tree, item);
    return made;
}

void CBoneTreeView::ShowMarkers(const CBoneTree& tree)
{
    for (const int item : m_kOrder)
    {
        if (BoneOf(item).m_bMapped != tree.IsMapped(item))
            ShowMarker(tree, item);
    }
}

void CBoneTreeView::ShowMarker(const CBoneTree& tree, int item)
{
    Bone& bone = BoneOf(item);
    bone.m_bMapped = tree.IsMapped(item);
    bone.m_pkItem->setIcon(0, BoneMarker(tree.Image(item), tree.SelectedImage(item)));
    bone.m_pkItem->setData(0, Qt::AccessibleDescriptionRole,
                           bone.m_bMapped ? tr("mapped") : tr("not mapped"));
}

void CBoneTreeView::ShowSelection(const CBoneTree& tree)
{
    const int selected = tree.Selected();
    QTreeWidgetItem* const item = selected == CBoneTree::kNone ? nullptr : BoneOf(selected).m_pkItem;
    if (!item)
        clearSelection();
    else if (!item->isSelected())
        setCurrentItem(item); // scrolls to it
}

bool CBoneTreeView::SelectFirst()
{
    QTreeWidgetItem* const first = topLevelItem(0);
    setCurrentItem(first);
    return first != nullptr;
}

void CBoneTreeView::NoteFolding(const QTreeWidgetItem* item, bool folded)
{
    if (!m_bShowing)
        BoneOf(ItemOf(item)).m_bFolded = folded;
}

void CBoneTreeView::selectionChanged(const QItemSelection& selected, const QItemSelection& deselected)
{
    QTreeWidget::selectionChanged(selected, deselected);
    if (!m_bShowing)
        onSelect_(ItemOf(selectedItems().value(0)));
}

} // namespace gw
