#include "CBoneTreeView.h"

#include "CBoneTree.h"
#include "QtText.h"

#include <QCoreApplication>
#include <QIcon>
#include <QPainter>
#include <QSignalBlocker>

namespace gw {

namespace {

constexpr int kIconSide = 12;
constexpr int kIndentation = 14;
constexpr qreal kRingWidth = 1.5;
constexpr int kItemRole = Qt::UserRole;

QIcon DotIcon(const QWidget& widget, bool full)
{
    QPixmap picture(QSize(kIconSide, kIconSide) * widget.devicePixelRatio());
    picture.setDevicePixelRatio(widget.devicePixelRatio());
    picture.fill(Qt::transparent);
    QPainter painter(&picture);
    painter.setRenderHint(QPainter::Antialiasing);
    const QColor color = widget.palette().color(QPalette::Text);
    painter.setPen(QPen(color, kRingWidth));
    painter.setBrush(full ? QBrush(color) : QBrush());
    painter.drawEllipse(QRectF(2, 2, kIconSide - 4, kIconSide - 4));
    return QIcon(picture);
}

} // namespace

CBoneTreeView::CBoneTreeView(QWidget* parent) : QTreeWidget(parent)
{
    setHeaderHidden(true);
    setUniformRowHeights(true);
    setIndentation(kIndentation);
    setIconSize(QSize(kIconSide, kIconSide));
    connect(this, &QTreeWidget::currentItemChanged, this, [this](const QTreeWidgetItem* item) {
        if (m_kSelected)
            m_kSelected(item ? item->data(0, kItemRole).toInt() : CBoneTree::kNone);
    });
}

void CBoneTreeView::Show(const CBoneTree& tree)
{
    const QSignalBlocker blocker(this);
    if (!ShowsBonesOf(tree))
        Rebuild(tree);
    ShowMarks(tree);
    ShowSelection(tree);
}

bool CBoneTreeView::ShowsBonesOf(const CBoneTree& tree) const
{
    const auto& bones = tree.Items();
    if (bones.size() != m_kItems.size())
        return false;
    for (size_t i = 0; i < bones.size(); ++i)
    {
        const QTreeWidgetItem* const parent = m_kItems[i]->parent();
        const int parentItem = parent ? parent->data(0, kItemRole).toInt() : CBoneTree::kNone;
        if (m_kItems[i]->text(0) != ToQString(bones[i].m_kText) || parentItem != bones[i].m_iParent)
            return false;
    }
    return true;
}

void CBoneTreeView::Rebuild(const CBoneTree& tree)
{
    clear();
    m_kItems.clear();
    for (const CBoneTree::Item& bone : tree.Items())
    {
        auto* const item = new QTreeWidgetItem({ToQString(bone.m_kText)});
        item->setData(0, kItemRole, static_cast<int>(m_kItems.size()));
        if (bone.m_iParent == CBoneTree::kNone)
            addTopLevelItem(item);
        else
            m_kItems[static_cast<size_t>(bone.m_iParent)]->addChild(item);
        m_kItems.push_back(item);
    }
    expandAll();
}

// The marks are drawn anew: they have the colour of the text, which a style sheet may set at any time.
void CBoneTreeView::ShowMarks(const CBoneTree& tree)
{
    ensurePolished();
    const QIcon full = DotIcon(*this, true);
    const QIcon ring = DotIcon(*this, false);
    const QString said = QCoreApplication::translate("GaitTool", "mapped");
    for (size_t i = 0; i < m_kItems.size(); ++i)
    {
        const bool mapped = tree.IsMapped(static_cast<int>(i));
        m_kItems[i]->setIcon(0, mapped ? full : ring);
        m_kItems[i]->setData(0, Qt::AccessibleDescriptionRole, mapped ? said : QString());
    }
}

void CBoneTreeView::ShowSelection(const CBoneTree& tree)
{
    const int selected = tree.Selected();
    QTreeWidgetItem* const item =
        selected == CBoneTree::kNone ? nullptr : m_kItems[static_cast<size_t>(selected)];
    if (item == currentItem())
        return;
    setCurrentItem(item);
    if (item)
        scrollToItem(item);
}

} // namespace gw
