// Applies a changed row table to the view with as few changes as possible, so that scrolling and selection
// survive.

#include "CMapRowModel.h"

#include "QtText.h"

#include <algorithm>
#include <iterator>

namespace gw {

namespace {

CMapRowTable::Row RowOf(const CMapRowTable& rows, int row)
{
    CMapRowTable::Row texts;
    for (int column = 0; column < kMapColumnCount; ++column)
        texts[static_cast<size_t>(column)] = rows.Text(row, column);
    return texts;
}

std::vector<CMapRowTable::Row> RowsOf(const CMapRowTable& rows)
{
    std::vector<CMapRowTable::Row> texts;
    texts.reserve(static_cast<size_t>(rows.RowCount()));
    for (int row = 0; row < rows.RowCount(); ++row)
        texts.push_back(RowOf(rows, row));
    return texts;
}

Qt::Alignment AlignmentOf(int column)
{
    return Qt::AlignVCenter | (kMapColumnTitles[column].alignRight ? Qt::AlignRight : Qt::AlignLeft);
}

} // namespace

CMapRowModel::CMapRowModel(QStringList titles, QObject* parent)
    : QAbstractTableModel(parent), m_kTitles(std::move(titles))
{
}

// Between the rows that are equal at the top and at the bottom, existing rows change their texts, and the
// difference is inserted or removed.
void CMapRowModel::ShowRows(const CMapRowTable& table)
{
    std::vector<CMapRowTable::Row> rows = RowsOf(table);
    const auto top = std::ranges::mismatch(m_kRows, rows);
    const auto same =
        std::mismatch(std::make_reverse_iterator(m_kRows.end()), std::make_reverse_iterator(top.in1),
                      std::make_reverse_iterator(rows.end()), std::make_reverse_iterator(top.in2));
    const int first = static_cast<int>(top.in1 - m_kRows.begin());
    const int oldEnd = static_cast<int>(same.first.base() - m_kRows.begin());
    const int newEnd = static_cast<int>(same.second.base() - rows.begin());
    const int changedEnd = std::min(oldEnd, newEnd);
    if (oldEnd > newEnd)
        beginRemoveRows({}, changedEnd, oldEnd - 1);
    else if (oldEnd < newEnd)
        beginInsertRows({}, changedEnd, newEnd - 1);
    m_kRows = std::move(rows);
    if (oldEnd > newEnd)
        endRemoveRows();
    else if (oldEnd < newEnd)
        endInsertRows();
    if (first < changedEnd)
        emit dataChanged(index(first, 0), index(changedEnd - 1, columnCount() - 1));
}

int CMapRowModel::rowCount(const QModelIndex& parent) const
{
    return parent.isValid() ? 0 : static_cast<int>(m_kRows.size());
}

int CMapRowModel::columnCount(const QModelIndex& parent) const
{
    return parent.isValid() ? 0 : static_cast<int>(std::size(kMapColumnTitles));
}

QString CMapRowModel::Text(const QModelIndex& index) const
{
    const auto column = static_cast<size_t>(index.column());
    return column < kMapColumnCount ? ToQString(m_kRows[static_cast<size_t>(index.row())][column])
                                    : QString();
}

QVariant CMapRowModel::data(const QModelIndex& index, int role) const
{
    if (!index.isValid())
        return {};
    switch (role)
    {
    case Qt::DisplayRole:
        return Text(index);
    case Qt::ToolTipRole: // long names are elided in the middle
        return index.column() < kRotationColumn ? Text(index) : QVariant();
    case Qt::TextAlignmentRole:
        return QVariant::fromValue(AlignmentOf(index.column()));
    default:
        return {};
    }
}

QVariant CMapRowModel::headerData(int section, Qt::Orientation orientation, int role) const
{
    if (orientation != Qt::Horizontal)
        return {};
    if (role == Qt::DisplayRole)
        return m_kTitles.value(section);
    return role == Qt::TextAlignmentRole ? QVariant::fromValue(AlignmentOf(section)) : QVariant();
}

} // namespace gw
