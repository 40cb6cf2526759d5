#pragma once

#include <QLabel>
#include <functional>

namespace gw {

/// The window's title: elided if it is too long, shown in full in its tool tip.
class CTitleLabel : public QLabel
{
public:
    explicit CTitleLabel(QWidget* parent) : QLabel(parent) {}

    /// Paints immediately, even while an operation blocks the event loop.
    void ShowAtOnce(const QString& text);

    std::function<void(const QPoint& globalPosition)> mouseDown;

protected:
    void mousePressEvent(QMouseEvent* event) override;
};

} // namespace gw
