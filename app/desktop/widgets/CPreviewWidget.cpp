#include "CPreviewWidget.h"

#include "CLeftKeys.h"
#include "GLPainter.h"
#include "GLScene.h"

#include <QGuiApplication>
#include <QMouseEvent>
#include <QOpenGLContext>
#include <QPointer>
#include <QSurfaceFormat>
#include <algorithm>

namespace gw {

// The view and its widget may die in either order.
class CPreviewWidget::CWidgetView : public CGLView
{
public:
    explicit CWidgetView(CPreviewWidget* widget) : m_kWidget(widget)
    {
        SetRepaint([this] {
            if (m_kWidget)
                m_kWidget->update();
        });
    }
    ~CWidgetView() override
    {
        if (m_kWidget && m_kWidget->m_pkView == this)
            m_kWidget->m_pkView = nullptr;
    }

private:
    QPointer<CPreviewWidget> m_kWidget;
};

CPreviewWidget::CPreviewWidget(const CLeftKeys& keys, QWidget* parent) : QOpenGLWidget(parent), m_kKeys(keys)
{
}

std::unique_ptr<CGLView> CPreviewWidget::MakeView()
{
    auto view = std::make_unique<CWidgetView>(this);
    m_pkView = view.get();
    return view;
}

void CPreviewWidget::initializeGL()
{
    InitGL();
}

void CPreviewWidget::resizeGL(int width, int height)
{
    const qreal ratio = devicePixelRatio();
    ResizeGL(qRound(width * ratio), qRound(height * ratio));
}

void CPreviewWidget::paintGL()
{
    CGLView empty;
    PaintGL(SceneOf(m_pkView ? *m_pkView : empty));
}

void CPreviewWidget::mousePressEvent(QMouseEvent* event)
{
    const QPoint at = event->position().toPoint();
    if (m_pkView && event->button() == Qt::LeftButton)
        m_pkView->MouseDown(at.x(), at.y());
}

void CPreviewWidget::mouseReleaseEvent(QMouseEvent* event)
{
    if (m_pkView && event->button() == Qt::LeftButton)
        m_pkView->MouseUp();
}

void CPreviewWidget::mouseMoveEvent(QMouseEvent* event)
{
    const QPoint at = event->position().toPoint();
    if (m_pkView)
        m_pkView->MouseMove(at.x(), at.y(),
                            {m_kKeys.IsDown(EKey::LeftCtrl), m_kKeys.IsDown(EKey::LeftShift)});
}

// The toolkit's screens that mix no GL into a window may give a context all the same, and crash in the
// widget.
bool HasOpenGL()
{
    constexpr const char* kScreensWithoutViews[] = {"offscreen", "minimal", "linuxfb", "vnc"};
    const auto isScreen = [](const char* name) {
        return QGuiApplication::platformName() == QLatin1String(name);
    };
    QOpenGLContext context;
    return std::ranges::none_of(kScreensWithoutViews, isScreen) && context.create();
}

void RequestPreviewFormat()
{
    QSurfaceFormat format;
    format.setVersion(2, 1);
    format.setProfile(QSurfaceFormat::CompatibilityProfile);
    format.setRedBufferSize(kPixelFormat.redBits);
    format.setGreenBufferSize(kPixelFormat.greenBits);
    format.setBlueBufferSize(kPixelFormat.blueBits);
    format.setDepthBufferSize(kPixelFormat.depthBits);
    QSurfaceFormat::setDefaultFormat(format);
}

} // namespace gw
