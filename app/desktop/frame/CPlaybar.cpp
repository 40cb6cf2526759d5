#include "CPlaybar.h"

#include <QKeyEvent>
#include <QMouseEvent>
#include <QStyle>
#include <QWheelEvent>

namespace gw {

namespace {

constexpr int kHandleWidth = 14; // its middle is at the value

} // namespace

void CPlaybar::GoTo(int x)
{
    const int wanted =
        QStyle::sliderValueFromPosition(minimum(), maximum(), x - kHandleWidth / 2, width() - kHandleWidth);
    setValue(wanted);
    if (scroll)
        scroll(wanted);
}

void CPlaybar::mousePressEvent(QMouseEvent* event)
{
    if (event->button() != Qt::LeftButton)
        return;
    setSliderDown(true);
    if (mouseDown)
        mouseDown();
    GoTo(event->position().toPoint().x());
}

void CPlaybar::mouseMoveEvent(QMouseEvent* event)
{
    if (isSliderDown())
        GoTo(event->position().toPoint().x());
}

void CPlaybar::mouseReleaseEvent(QMouseEvent* event)
{
    if (event->button() != Qt::LeftButton || !isSliderDown())
        return;
    setSliderDown(false);
    if (mouseUp)
        mouseUp();
}

void CPlaybar::keyPressEvent(QKeyEvent* event)
{
    event->ignore();
}

void CPlaybar::wheelEvent(QWheelEvent* event)
{
    event->ignore();
}

} // namespace gw
