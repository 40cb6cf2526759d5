#pragma once

#include "CGLView.h"

#include <QOpenGLWidget>
#include <functional>
#include <memory>
#include <string>

class QLabel;

namespace gw {

class CLeftKeys;
class CViewButton;

/// The surface of a view: draws it with GL and forwards mouse events. The bone under the mouse is named next
/// to it. Create it only if HasOpenGL returns true.
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

    /// Called to switch following on or off. By default, this view alone is switched.
    std::function<void(bool on)> follow;
    /// Called when a bone is clicked without dragging.
    std::function<void(const std::string& bone)> clickBone = [](const std::string&) {};

protected:
    bool event(QEvent* event) override;
    void resizeEvent(QResizeEvent* event) override;
    void wheelEvent(QWheelEvent* event) override;
    void leaveEvent(QEvent* event) override;
    void initializeGL() override;
    void resizeGL(int width, int height) override;
    void paintGL() override;
    void mousePressEvent(QMouseEvent* event) override;
    void mouseReleaseEvent(QMouseEvent* event) override;
    void mouseMoveEvent(QMouseEvent* event) override;

private:
    class CWidgetView;

    std::string BoneAt(const QPointF& at) const;
    void NameBoneAt(const QPointF& at);
    void ShowView();
    void ShowNote(const QString& text);
    void PlaceNote();

    const CLeftKeys& keys_;
    CGLView* m_pkView = nullptr;
    CViewButton* m_pkFollow;
    QLabel* m_pkBoneName; ///< next to the mouse
    QLabel* m_pkNote;     ///< in the lower left corner
    QPointF m_kPressed;   ///< where the left button went down
};

/// Returns whether the system can create the context that previews need.
bool HasOpenGL();
/// Requests that kind of context for all widgets of the program. Call it before the application exists.
void RequestPreviewFormat();

} // namespace gw
