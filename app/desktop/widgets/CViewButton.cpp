#include "CViewButton.h"

#include <QPainter>

namespace gw {

namespace {

constexpr int kSide = 28;
constexpr double kRadius = 5.0; // of the sight's ring
constexpr double kReach = 9.0;  // of its hairs, from the center

} // namespace

CViewButton::CViewButton(QWidget* view) : QToolButton(view)
{
    setObjectName(QStringLiteral("follow"));
    setCheckable(true);
    setFocusPolicy(Qt::NoFocus); // the key T does the same
    setCursor(Qt::ArrowCursor);
    setAccessibleName(tr("Follow the figure"));
    setToolTip(tr("Keep the figure's hip in the middle (T)"));
    resize(kSide, kSide);
}

QSize CViewButton::sizeHint() const
{
    return {kSide, kSide};
}

void CViewButton::paintEvent(QPaintEvent* event)
{
    QToolButton::paintEvent(event);
    QPainter painter(this);
    painter.setRenderHint(QPainter::Antialiasing);
    painter.translate(QRectF(rect()).center());
    painter.setPen(QPen(palette().color(QPalette::ButtonText), 1.5));
    painter.drawEllipse(QPointF(), kRadius, kRadius);
    for (int hair = 0; hair < 4; ++hair)
    {
        painter.drawLine(QPointF(kRadius - 2, 0), QPointF(kReach, 0));
        painter.rotate(90);
    }
}

} // namespace gw
