#include "CMessageFilter.h"

#include <QApplication>
#include <QKeyEvent>
#include <QMouseEvent>
#include <QWidget>

namespace gw {

namespace {

constexpr qint64 kDoubleClickMilliseconds = 500;

bool IsLeftPress(const QEvent& event)
{
    const QEvent::Type type = event.type();
    return (type == QEvent::MouseButtonPress || type == QEvent::MouseButtonDblClick) &&
           static_cast<const QMouseEvent&>(event).button() == Qt::LeftButton;
}

bool IsAltF4(const QEvent& event)
{
    if (event.type() != QEvent::KeyPress)
        return false;
    const auto& key = static_cast<const QKeyEvent&>(event);
    return key.key() == Qt::Key_F4 && key.modifiers().testFlag(Qt::AltModifier);
}

} // namespace

CMessageFilter::CMessageFilter(std::function<void()> requestClose) : requestClose_(std::move(requestClose))
{
    QCoreApplication::instance()->installEventFilter(this);
}

void CMessageFilter::RememberCorner(const QPoint& globalPosition)
{
    m_kCorner = globalPosition;
    m_kSinceCorner.start();
}

bool CMessageFilter::IsCornerAgain(const QPoint& globalPosition) const
{
    return m_kSinceCorner.isValid() && !m_kSinceCorner.hasExpired(kDoubleClickMilliseconds) &&
           globalPosition == m_kCorner;
}

bool CMessageFilter::eventFilter(QObject* watched, QEvent* event)
{
    if (IsAltF4(*event) && !QApplication::activeModalWidget())
    {
        requestClose_();
        return true;
    }
    if (!watched->isWidgetType() || !IsLeftPress(*event))
        return false;
    const bool again = IsCornerAgain(static_cast<const QMouseEvent&>(*event).globalPosition().toPoint());
    m_kSinceCorner.invalidate();
    if (!again)
        return false;
    if (QWidget* menu = QApplication::activePopupWidget())
        menu->close();
    requestClose_();
    return true;
}

} // namespace gw
