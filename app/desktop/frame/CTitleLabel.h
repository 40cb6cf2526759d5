#pragma once

#include <QLabel>
#include <functional>

namespace gw {

/// The window's title: cut with dots where it is too long, whole in its tool tip.
class CTitleLabel : public QLabel
{
public:
    explicit CTitleLabel(QWidget* parent) : QLabel(parent) {}

    /// Paints at once, also while an operation keeps the program from its events.
    void ShowAtOnce(const QString& text);

    std::function<void(const QPoint& globalPosition)> mouseDown;

protected:
    void mousePressEvent(QMouseEvent* event) override;
};

} // namespace gw
