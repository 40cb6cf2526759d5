// The table view of the editor's rows: reports selections and clicks to the model, by mouse or keyboard.

#include "CMapRowView.h"

#include "CGaitConvertContent.h"
#include "CMapRowModel.h"
#include "QtText.h"

#include <QHeaderView>
#include <QMouseEvent>
#include <QScopedValueRollback>

namespace gw {

namespace {

constexpr int kRowMargin = 6; // pixels above and below a row's text, together

QStringList Titles(const CGaitConvertContent& content)
{
    QStringList titles;
    for (const MapColumnTitle& column : kMapColumnTitles)
        titles << (column.messageId ? ToQString(content.Message(column.messageId)) : QStringLiteral(" "));
    return titles;
}

} // namespace

CMapRowView::CMapRowView(const CGaitConvertContent& content, QWidget* parent)
    : QTableView(parent), m_pkModel(new CMapRowModel(Titles(content), this))
{
    setModel(m_pkModel);
    setSelectionBehavior(SelectRows);
    setSelectionMode(ExtendedSelection);
    setEditTriggers(NoEditTriggers);
    setTabKeyNavigation(false);
    setShowGrid(false);
    setWordWrap(false);
    setTextElideMode(Qt::ElideMiddle);
    // The columns fill the table; the last one may extend a little beyond it.
    setHorizontalScrollBarPolicy(Qt::ScrollBarAlwaysOff);
    horizontalHeader()->setSectionResizeMode(QHeaderView::Fixed);
    horizontalHeader()->setMinimumSectionSize(1);
    horizontalHeader()->setHighlightSections(false);
    horizontalHeader()->setSectionsClickable(false);
    verticalHeader()->setSectionResizeMode(QHeaderView::Fixed);
    verticalHeader()->setDefaultSectionSize(fontMetrics().height() + kRowMargin);
    verticalHeader()->hide();
}

void CMapRowView::ShowRows(const CMapRowTable& rows)
{
    const QScopedValueRollback showing(m_bShowing, true);
    m_pkModel->ShowRows(rows);
    ShowSelection(rows);
}

void CMapRowView::ShowSelection(const CMapRowTable& rows)
{
    QItemSelection wanted;
    bool same = true;
    for (int row = 0; row < rows.RowCount(); ++row)
    {
        const QModelIndex index = m_pkModel->index(row, 0);
        const bool selected = rows.IsSelected(row);
        same = same && selected == selectionModel()->isSelected(index);
        if (selected)
            wanted.select(index, index);
    }
    if (!same)
        selectionModel()->select(wanted, QItemSelectionModel::ClearAndSelect | QItemSelectionModel::Rows);
}

void CMapRowView::TellSelection(const QItemSelection& rows, bool selected)
{
    for (const QItemSelectionRange& range : rows)
    {
        for (int row = range.top(); row <= range.bottom(); ++row)
            m_kCallbacks.select(row, selected);
    }
}

void CMapRowView::selectionChanged(const QItemSelection& selected, const QItemSelection& deselected)
{
    QTableView::selectionChanged(selected, deselected);
    if (m_bShowing)
        return;
    m_bSelectionChanged = true;
    TellSelection(deselected, false);
    TellSelection(selected, true);
}

// Dragging over rows and out of the list counts as a click on the last of them.
void CMapRowView::mouseReleaseEvent(QMouseEvent* event)
{
    QTableView::mouseReleaseEvent(event);
    const QPoint at = event->position().toPoint();
    if (event->button() == Qt::LeftButton)
        m_kCallbacks.click((viewport()->rect().contains(at) ? indexAt(at) : currentIndex()).row());
}

void CMapRowView::mouseDoubleClickEvent(QMouseEvent* event)
{
    QTableView::mouseDoubleClickEvent(event);
    const int row = indexAt(event->position().toPoint()).row();
    if (event->button() == Qt::LeftButton && row >= 0)
        m_kCallbacks.doubleClick(row);
}

// Selecting by keyboard counts as a click on the last row; otherwise the list would need a mouse.
void CMapRowView::keyPressEvent(QKeyEvent* event)
{
    m_bSelectionChanged = false;
    QTableView::keyPressEvent(event);
    if (m_bSelectionChanged)
        m_kCallbacks.click(currentIndex().row());
}

void CMapRowView::resizeEvent(QResizeEvent* event)
{
    QTableView::resizeEvent(event);
    for (int column = 0; column < m_pkModel->columnCount(); ++column)
    {
        const MapColumnTitle& title = kMapColumnTitles[column];
        setColumnWidth(column, width() * title.widthNumerator / title.widthDenominator);
    }
}

} // namespace gw
