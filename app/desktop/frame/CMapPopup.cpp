#include "CMapPopup.h"

#include "CMapField.h"

#include <QApplication>
#include <QBoxLayout>
#include <QComboBox>
#include <QCoreApplication>
#include <QKeyEvent>
#include <QLineEdit>
#include <QListView>
#include <QPainter>
#include <QScreen>
#include <QScrollBar>
#include <QStyledItemDelegate>
#include <algorithm>

namespace gw {

namespace {

constexpr int kRows = 16;
constexpr int kWidth = 500;
constexpr int kGap = 2;
constexpr int kItemMargin = 8;

// Draws a name on the left and, dimmer, its words on the right.
class CMapDelegate : public QStyledItemDelegate
{
public:
    using QStyledItemDelegate::QStyledItemDelegate;

    void paint(QPainter* painter, const QStyleOptionViewItem& option, const QModelIndex& index) const override
    {
        QStyleOptionViewItem item = option;
        initStyleOption(&item, index);
        const QString words = index.data(CMapField::kWordsRole).toString();
        const QRect room = item.rect.adjusted(kItemMargin, 0, -kItemMargin, 0);
        const int wordsWidth = item.fontMetrics.horizontalAdvance(words);
        const int nameWidth = room.width() - (words.isEmpty() ? 0 : wordsWidth + kItemMargin);
        const QString name = item.fontMetrics.elidedText(item.text, Qt::ElideRight, nameWidth);
        item.text.clear();
        item.widget->style()->drawControl(QStyle::CE_ItemViewItem, &item, painter, item.widget);
        const bool selected = item.state.testFlag(QStyle::State_Selected);
        painter->setPen(item.palette.color(selected ? QPalette::HighlightedText : QPalette::Text));
        painter->drawText(room, Qt::AlignVCenter | Qt::AlignLeft, name);
        painter->setOpacity(selected ? 1.0 : 0.75);
        painter->drawText(room, Qt::AlignVCenter | Qt::AlignRight, words);
        painter->setOpacity(1.0);
    }

    QSize sizeHint(const QStyleOptionViewItem& option, const QModelIndex& index) const override
    {
        const QSize size = QStyledItemDelegate::sizeHint(option, index);
        return {1, std::max(size.height(), option.fontMetrics.height() + kItemMargin)};
    }
};

} // namespace

CMapPopup::CMapPopup(QComboBox& field, const QString& filter)
    : QFrame(field.window(), Qt::Popup), field_(field), m_pkFilter(new QLineEdit(this)),
      m_pkList(new QListView(this))
{
    setObjectName(QStringLiteral("maps"));
    setAttribute(Qt::WA_DeleteOnClose);
    setAttribute(Qt::WA_StyledBackground);
    setAccessibleName(QCoreApplication::translate("Face", "Bone maps"));
    m_kShown.setSourceModel(field.model());
    m_kShown.setFilterCaseSensitivity(Qt::CaseInsensitive);
    m_pkFilter->setObjectName(QStringLiteral("mapFilter"));
    m_pkFilter->setPlaceholderText(QCoreApplication::translate("Face", "Filter by name"));
    m_pkFilter->setAccessibleName(m_pkFilter->placeholderText());
    m_pkFilter->setClearButtonEnabled(true);
    m_pkList->setObjectName(QStringLiteral("mapList"));
    m_pkList->setModel(&m_kShown);
    m_pkList->setItemDelegate(new CMapDelegate(this));
    m_pkList->setUniformItemSizes(true);
    m_pkList->setHorizontalScrollBarPolicy(Qt::ScrollBarAlwaysOff);
    m_pkList->setEditTriggers(QAbstractItemView::NoEditTriggers);
    m_pkList->setFont(field.view()->font());
    m_pkList->setFocusPolicy(Qt::NoFocus); // keys go to the filter
    auto* const layout = new QVBoxLayout(this);
    layout->setContentsMargins(6, 6, 6, 6);
    layout->setSpacing(6);
    layout->addWidget(m_pkFilter);
    layout->addWidget(m_pkList);
    setFocusProxy(m_pkFilter);
    m_pkFilter->installEventFilter(this);
    connect(m_pkFilter, &QLineEdit::textChanged, this, [this](const QString& text) { Filter(text); });
    connect(m_pkList, &QListView::clicked, this, [this] { Choose(); });
    m_pkList->setCurrentIndex(m_kShown.index(std::max(field.currentIndex(), 0), 0));
    m_pkFilter->setText(filter);
    Place();
    m_pkFilter->setFocus();
}

void CMapPopup::Place()
{
    ensurePolished();
    const int rowHeight = std::max(m_pkList->sizeHintForRow(0), 1);
    const int rows = std::clamp(m_kShown.sourceModel()->rowCount(), 4, kRows);
    m_pkList->setFixedHeight(rows * rowHeight + 2 * m_pkList->frameWidth() + 6);
    setFixedWidth(std::max(kWidth, field_.width()));
    adjustSize();
    const QRect screen = field_.screen()->availableGeometry();
    QPoint place = field_.mapToGlobal(QPoint(0, field_.height() + kGap));
    if (place.y() + height() > screen.bottom())
        place.setY(field_.mapToGlobal(QPoint(0, 0)).y() - height() - kGap);
    place.setX(std::max(screen.left(), std::min(place.x(), screen.right() - width())));
    place.setY(std::max(screen.top(), place.y()));
    move(place);
    m_pkList->scrollTo(m_pkList->currentIndex());
}

void CMapPopup::Filter(const QString& text)
{
    m_kShown.setFilterFixedString(text);
    m_pkList->setCurrentIndex(m_kShown.index(0, 0));
}

void CMapPopup::Choose()
{
    const QModelIndex index = m_pkList->currentIndex();
    if (!index.isValid())
        return;
    const int row = m_kShown.mapToSource(index).row();
    const auto choose = chosen;
    close();
    choose(row);
}

void CMapPopup::Step(int rows)
{
    const int last = m_kShown.rowCount() - 1;
    const int row = std::clamp(m_pkList->currentIndex().row() + rows, 0, std::max(last, 0));
    m_pkList->setCurrentIndex(m_kShown.index(row, 0));
}

// Escape clears the filter before it closes the list.
bool CMapPopup::eventFilter(QObject*, QEvent* event)
{
    if (event->type() != QEvent::KeyPress)
        return false;
    switch (static_cast<QKeyEvent*>(event)->key())
    {
    case Qt::Key_Up:
        Step(-1);
        return true;
    case Qt::Key_Down:
        Step(1);
        return true;
    case Qt::Key_PageUp:
        Step(-kRows);
        return true;
    case Qt::Key_PageDown:
        Step(kRows);
        return true;
    case Qt::Key_Return:
    case Qt::Key_Enter:
        Choose();
        return true;
    case Qt::Key_Escape:
        if (m_pkFilter->text().isEmpty())
            close();
        else
            m_pkFilter->clear();
        return true;
    default:
        return false;
    }
}

} // namespace gw
