#pragma once

#include <QFrame>
#include <QSortFilterProxyModel>
#include <functional>

class QComboBox;
class QLineEdit;
class QListView;

namespace gw {

/// The open list of bone maps: a filter, and the names with how well they fit. Deletes itself when it closes.
class CMapPopup : public QFrame
{
public:
    /// Opens next to the field, where the screen has more room.
    CMapPopup(QComboBox& field, const QString& filter);

    /// Called with the row of the chosen map, after the list has closed.
    std::function<void(int row)> chosen;

protected:
    bool eventFilter(QObject* watched, QEvent* event) override;

private:
    void Place();
    void Filter(const QString& text);
    void Choose();
    void Step(int rows);

    QComboBox& field_;
    QSortFilterProxyModel m_kShown;
    QLineEdit* m_pkFilter;
    QListView* m_pkList;
};

} // namespace gw
