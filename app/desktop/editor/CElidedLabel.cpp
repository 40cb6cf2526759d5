#include "CElidedLabel.h"

namespace gw {

CElidedLabel::CElidedLabel(QWidget* parent) : QLabel(parent)
{
    // otherwise a long text would widen the window
    setSizePolicy(QSizePolicy::Ignored, QSizePolicy::Preferred);
}

void CElidedLabel::ShowText(const QString& text)
{
    m_kText = text;
    Fit();
}

void CElidedLabel::resizeEvent(QResizeEvent* event)
{
    QLabel::resizeEvent(event);
    Fit();
}

void CElidedLabel::Fit()
{
    setText(fontMetrics().elidedText(m_kText, Qt::ElideMiddle, contentsRect().width()));
    setToolTip(text() == m_kText ? QString() : m_kText);
}

} // namespace gw
