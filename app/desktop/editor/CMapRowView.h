#pragma once

#include <QTableView>
#include <functional>

namespace gw {

class CGaitConvertContent;
class CMapRowModel;
class CMapRowTable;

/// The editor's list of rows. Whole rows are selected, several at a time.
class CMapRowView : public QTableView
{
public:
    struct Callbacks
    {
        std::function<void(int row, bool selected)> select; ///< once per changed row
        std::function<void(int row)> click;                 ///< after the selection; -1 for no row
        std::function<void(int row)> doubleClick;
    };

    /// `content` provides the column names.
    CMapRowView(const CGaitConvertContent& content, QWidget* parent);

    void SetCallbacks(Callbacks callbacks) { m_kCallbacks = std::move(callbacks); }
    /// Shows a table and its selection.
    void ShowRows(const CMapRowTable& rows);

protected:
    void selectionChanged(const QItemSelection& selected, const QItemSelection& deselected) override;
    void mouseReleaseEvent(QMouseEvent* event) override;
    void mouseDoubleClickEvent(QMouseEvent* event) override;
    void keyPressEvent(QKeyEvent* event) override;
    void resizeEvent(QResizeEvent* event) override;

private:
    void ShowSelection(const CMapRowTable& rows);
    void TellSelection(const QItemSelection& rows, bool selected);

    CMapRowModel* m_pkModel;
    Callbacks m_kCallbacks;
    bool m_bShowing = false;          ///< changes come from the table, not the user
    bool m_bSelectionChanged = false; ///< since a key was pressed
};

} // namespace gw
