#include "CMapField.h"

#include "CMapPopup.h"

#include <QCoreApplication>
#include <QKeyEvent>
#include <QStyleOptionComboBox>
#include <QStylePainter>
#include <QWheelEvent>

namespace gw {

CMapField::CMapField(QWidget* parent) : QComboBox(parent)
{
    setSizeAdjustPolicy(QComboBox::AdjustToMinimumContentsLengthWithIcon);
    setMinimumContentsLength(1);
}

void CMapField::showPopup()
{
    Open({});
}

void CMapField::Open(const QString& filter)
{
    if (m_kPopup)
        return;
    auto* const popup = new CMapPopup(*this, filter);
    m_kPopup = popup;
    popup->chosen = [this](int row) {
        setCurrentIndex(row);
        emit activated(row);
    };
    popup->show();
}

void CMapField::hidePopup()
{
    if (m_kPopup)
        m_kPopup->close();
    QComboBox::hidePopup();
}

// A name that is too long ends in dots.
void CMapField::paintEvent(QPaintEvent*)
{
    QStylePainter painter(this);
    QStyleOptionComboBox option;
    initStyleOption(&option);
    painter.drawComplexControl(QStyle::CC_ComboBox, option);
    const QRect room =
        style()->subControlRect(QStyle::CC_ComboBox, &option, QStyle::SC_ComboBoxEditField, this);
    const bool none = currentIndex() < 0;
    const QString text =
        none ? QCoreApplication::translate("Face", "No bone map selected") : option.currentText;
    if (none)
        option.palette.setBrush(QPalette::ButtonText, option.palette.placeholderText());
    option.currentText = option.fontMetrics.elidedText(text, Qt::ElideRight, room.width());
    painter.drawControl(QStyle::CE_ComboBoxLabel, option);
}

void CMapField::wheelEvent(QWheelEvent* event)
{
    event->ignore();
}

// Typing starts a search.
void CMapField::keyPressEvent(QKeyEvent* event)
{
    const QString text = event->text();
    const bool types = !text.isEmpty() && text[0].isPrint() && !text[0].isSpace() &&
                       !(event->modifiers() & (Qt::ControlModifier | Qt::AltModifier));
    if (types)
        Open(text);
    else if (event->key() == Qt::Key_Return || event->key() == Qt::Key_Enter)
        Open({});
    else
        QComboBox::keyPressEvent(event);
}

} // namespace gw
