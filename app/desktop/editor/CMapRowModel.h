#pragma once

#include "CMapRowTable.h"

#include <QAbstractTableModel>
#include <QStringList>
#include <vector>

namespace gw {

/// The rows of a bone map as they were last shown. Takes over a changed table row by row, so that the rows
/// around a change keep their place on the screen.
class CMapRowModel : public QAbstractTableModel
{
public:
    /// Titles for the columns of kMapColumnTitles.
    CMapRowModel(QStringList titles, QObject* parent);

    void ShowRows(const CMapRowTable& rows);

    int rowCount(const QModelIndex& parent = {}) const override;
    int columnCount(const QModelIndex& parent = {}) const override;
    QVariant data(const QModelIndex& index, int role) const override;
    QVariant headerData(int section, Qt::Orientation orientation, int role) const override;

private:
    QString Text(const QModelIndex& index) const;

    QStringList m_kTitles;
    std::vector<CMapRowTable::Row> m_kRows;
};

} // namespace gw
