#pragma once

#include "CGLView.h"

#include <QOpenGLWidget>
#include <memory>

namespace gw {

class CLeftKeys;

/// The surface of a view: draws it by GL and forwards the mouse to it. To be made only where HasOpenGL says
/// so.
class CPreviewWidget : public QOpenGLWidget
{
public:
    /// The keys must outlive the widget.
    CPreviewWidget(const CLeftKeys& keys, QWidget* parent);

    /// A new view, drawn here from now on and until it dies. It may outlive the widget. If the surface cannot
    /// have the format that a view needs, the user is told and the program asked to quit.
    std::unique_ptr<CGLView> MakeView();
    /// The view that is drawn here, or null.
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

/// Whether the system can make the context that previews are drawn in.
bool HasOpenGL();
/// Asks the toolkit for that kind of context, for every widget of the program; to be called before the
/// application exists.
void RequestPreviewFormat();

} // namespace gw
