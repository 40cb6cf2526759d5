#pragma once

#include "CGLView.h"

#include <QOpenGLWidget>
#include <memory>

namespace gw {

class CLeftKeys;

/// The surface of a view: draws it with GL and forwards mouse events. Create it only if HasOpenGL returns
/// true.
class CPreviewWidget : public QOpenGLWidget
{
public:
    /// `keys` must outlive the widget.
    CPreviewWidget(const CLeftKeys& keys, QWidget* parent);

    /// Creates a view that is drawn here until it is destroyed; it can outlive the widget. If the surface
    /// cannot have the required format, the user is told and the program is asked to quit.
    std::unique_ptr<CGLView> MakeView();
    /// Returns the view that is drawn here, or null.
    CGLView* View() const { return m_pkView; }

protected:
    void initializeGL() override;
    void resizeGL(int width, int height) override;
    void paintGL() override;
    void mousePressEvent(QMouseEvent* event) override;
    void mouseReleaseEvent(QMouseEvent* event) override;
    void mouseMoveEvent(QMouseEvent* event) override;

private:
    class CWidgetView;

    const CLeftKeys& keys_;
    CGLView* m_pkView = nullptr;
};

/// Returns whether the system can create the context that previews need.
bool HasOpenGL();
/// Requests that kind of context for all widgets of the program. Call it before the application exists.
void RequestPreviewFormat();

} // namespace gw
