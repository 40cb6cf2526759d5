// Draws a view with OpenGL. Machines without a usable context are detected before the toolkit can end the
// program.

#include "CPreviewWidget.h"

#include "CLeftKeys.h"
#include "CMessageBox.h"
#include "GLPainter.h"
#include "GLScene.h"

#include <QGuiApplication>
#include <QMouseEvent>
#include <QOffscreenSurface>
#include <QOpenGLContext>
#include <QPointer>
#include <QSurfaceFormat>
#include <algorithm>

namespace gw {

// View and widget can be destroyed in either order.
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

    bool SetupPixelFormat() override;
    void InitGL() override { gw::InitGL(); }

private:
    QPointer<CPreviewWidget> m_kWidget;
};

namespace {

bool FailFormat(QWidget* owner, const char* words)
{
    RunMessageBox(owner, "Error", words, EButtons::OK);
    return false;
}

} // namespace

// The toolkit creates the widget's context when it is first shown, and ends the program if that fails. So a
// context of the same format is tried first.
bool CPreviewWidget::CWidgetView::SetupPixelFormat()
{
    QOpenGLContext context;
    if (!context.create())
        return FailFormat(m_kWidget, "ChoosePixelFormat failed");
    QOffscreenSurface surface;
    surface.setFormat(context.format());
    surface.create();
    if (!context.makeCurrent(&surface))
        return FailFormat(m_kWidget, "SetPixelFormat failed");
    context.doneCurrent();
    m_kWidget->setFormat(QSurfaceFormat::defaultFormat());
    return true;
}

CPreviewWidget::CPreviewWidget(const CLeftKeys& keys, QWidget* parent) : QOpenGLWidget(parent), keys_(keys) {}

std::unique_ptr<CGLView> CPreviewWidget::MakeView()
{
    auto view = std::make_unique<CWidgetView>(this);
    m_pkView = view.get();
    if (!view->SetupPixelFormat()) // posted, because the application's loop may not be running yet
        QMetaObject::invokeMethod(qApp, &QCoreApplication::quit, Qt::QueuedConnection);
    return view;
}

void CPreviewWidget::initializeGL()
{
    CWidgetView empty(nullptr);
    (m_pkView ? *m_pkView : empty).InitGL();
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
        m_pkView->MouseMove(at.x(), at.y(), {keys_.IsDown(EKey::LeftCtrl), keys_.IsDown(EKey::LeftShift)});
}

// The toolkit's platforms that cannot combine GL with windows can still provide a context, and then crash in
// the widget.
bool HasOpenGL()
{
    constexpr const char* kScreensWithoutViews[] = {"offscreen", "minimal", "linuxfb", "vnc"};
    const auto isScreen = [](const char* name) {
        return QGuiApplication::platformName() == QLatin1String(name);
    };
    return std::ranges::none_of(kScreensWithoutViews, isScreen) && QOpenGLContext().create();
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
