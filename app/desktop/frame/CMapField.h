#pragma once

#include <QComboBox>
#include <QPointer>

namespace gw {

/// The closed list of bone maps: it shows the selected name, and opens a popup with all names and a filter.
/// The wheel changes nothing.
class CMapField : public QComboBox
{
public:
    /// The item role of the words beside a name.
    static constexpr int kWordsRole = Qt::UserRole + 1;

    explicit CMapField(QWidget* parent);

    void showPopup() override;
    void hidePopup() override;

protected:
    void paintEvent(QPaintEvent* event) override;
    void wheelEvent(QWheelEvent* event) override;
    void keyPressEvent(QKeyEvent* event) override;

private:
    void Open(const QString& filter);

    QPointer<QWidget> m_kPopup;
};

} // namespace gw
