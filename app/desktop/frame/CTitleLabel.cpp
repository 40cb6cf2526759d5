#include "CTitleLabel.h"

#include <QMouseEvent>

namespace gw {

void CTitleLabel::ShowAtOnce(const QString& text)
{
    setToolTip(text);
    setAccessibleName(text);
    setText(fontMetrics().elidedText(text, Qt::ElideRight, width()));
    repaint();
}

void CTitleLabel::mousePressEvent(QMouseEvent* event)
{
    if (event->button() == Qt::LeftButton && mouseDown)
        mouseDown(event->globalPosition().toPoint());
    else
        QLabel::mousePressEvent(event);
}

} // namespace gw
