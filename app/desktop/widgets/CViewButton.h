#pragma once

#include <QToolButton>

namespace gw {

/// The switch in a view's corner that makes the view follow the figure. Draws a sight in its text color.
class CViewButton : public QToolButton
{
public:
    explicit CViewButton(QWidget* view);

    QSize sizeHint() const override;

protected:
    void paintEvent(QPaintEvent* event) override;
};

} // namespace gw
