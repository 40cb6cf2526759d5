#pragma once

#include <QSlider>
#include <functional>

namespace gw {

/// The bar under the views: jumps to where the mouse is pressed and reports when a drag begins and ends. Keys
/// are left to the window.
class CPlaybar : public QSlider
{
public:
    explicit CPlaybar(QWidget* parent) : QSlider(Qt::Horizontal, parent) {}

    std::function<void()> mouseDown;
    std::function<void(int value)> scroll;
    std::function<void()> mouseUp;

protected:
    void mousePressEvent(QMouseEvent* event) override;
    void mouseMoveEvent(QMouseEvent* event) override;
    void mouseReleaseEvent(QMouseEvent* event) override;
    void keyPressEvent(QKeyEvent* event) override;
    void wheelEvent(QWheelEvent* event) override;

private:
    void GoTo(int x);
};

} // namespace gw
