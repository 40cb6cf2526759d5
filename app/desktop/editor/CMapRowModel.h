#pragma once

#include "CMapRowTable.h"

#include <QAbstractTableModel>
#include <QStringList>
#include <vector>

namespace gw {

/// The rows of a bone map as last shown. A changed table is applied row by row, so that rows around a change
/// keep their place on the screen.
class CMapRowModel : public QAbstractTableModel
{
public:
    /// `titles` belong to the columns of kMapColumnTitles.
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
