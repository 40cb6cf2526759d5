// Draws a view with OpenGL. Machines without a usable context are detected before the toolkit can end the
// program.

#include "CPreviewWidget.h"

#include "CLeftKeys.h"
#include "CMessageBox.h"
#include "CViewButton.h"
#include "GLPainter.h"
#include "GLScene.h"
#include "QtText.h"

#include <QApplication>
#include <QGuiApplication>
#include <QLabel>
#include <QMouseEvent>
#include <QOffscreenSurface>
#include <QOpenGLContext>
#include <QPointer>
#include <QSurfaceFormat>
#include <algorithm>

namespace gw {

namespace {

constexpr double kNotch = int{QWheelEvent::DefaultDeltasPerStep};
constexpr int kTagMargin = 8; // pixels around the texts and the button over a picture

} // namespace

// View and widget can be destroyed in either order.
class CPreviewWidget::CWidgetView : public CGLView
{
public:
    explicit CWidgetView(CPreviewWidget* widget) : m_kWidget(widget)
    {
        SetRepaint([this] {
            if (m_kWidget)
                m_kWidget->ShowView();
        });
    }
    ~CWidgetView() override
    {
        if (m_kWidget && m_kWidget->m_pkView == this)
            m_kWidget->m_pkView = nullptr;
    }

    bool SetupPixelFormat() override;
    void InitGL() override { gw::InitGL(); }
    void SetFollow(bool on) override
    {
        CGLView::SetFollow(on);
        if (m_kWidget)
            m_kWidget->m_pkFollow->setChecked(on);
    }
    void SetNote(const std::string& text) override
    {
        if (m_kWidget)
            m_kWidget->ShowNote(ToQString(text));
    }

private:
    QPointer<CPreviewWidget> m_kWidget;
};

namespace {

// A text over the picture that ignores the mouse.
QLabel* MakeTag(const char* name, QWidget* view)
{
    auto* const tag = new QLabel(view);
    tag->setObjectName(QLatin1String(name));
    tag->setProperty("kind", QStringLiteral("tag"));
    tag->setTextFormat(Qt::PlainText);
    tag->setAttribute(Qt::WA_TransparentForMouseEvents);
    tag->hide();
    return tag;
}

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

CPreviewWidget::CPreviewWidget(const CLeftKeys& keys, QWidget* parent)
    : QOpenGLWidget(parent), keys_(keys), m_pkFollow(new CViewButton(this)),
      m_pkBoneName(MakeTag("boneName", this)), m_pkNote(MakeTag("note", this))
{
    follow = [this](bool on) {
        if (m_pkView)
            m_pkView->SetFollow(on);
    };
    connect(m_pkFollow, &QToolButton::clicked, this, [this](bool on) { follow(on); });
    setMouseTracking(true);
}

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
    m_kPressed = event->position();
    const QPoint at = m_kPressed.toPoint();
    if (m_pkView && event->button() == Qt::LeftButton)
        m_pkView->MouseDown(at.x(), at.y());
}

void CPreviewWidget::mouseReleaseEvent(QMouseEvent* event)
{
    if (!m_pkView || event->button() != Qt::LeftButton)
        return;
    m_pkView->MouseUp();
    const QPointF moved = event->position() - m_kPressed;
    const std::string bone = BoneAt(event->position());
    if (moved.manhattanLength() < QApplication::startDragDistance() && !bone.empty())
        clickBone(bone);
}

void CPreviewWidget::mouseMoveEvent(QMouseEvent* event)
{
    const QPoint at = event->position().toPoint();
    if (m_pkView)
        m_pkView->MouseMove(at.x(), at.y(), {keys_.IsDown(EKey::LeftCtrl), keys_.IsDown(EKey::LeftShift)});
    NameBoneAt(event->position());
}

void CPreviewWidget::wheelEvent(QWheelEvent* event)
{
    if (m_pkView)
        m_pkView->Dolly(event->angleDelta().y() / kNotch);
    NameBoneAt(event->position());
}

void CPreviewWidget::leaveEvent(QEvent* event)
{
    m_pkBoneName->hide();
    QOpenGLWidget::leaveEvent(event);
}

// The tool tip would cover the bone's name.
bool CPreviewWidget::event(QEvent* event)
{
    return (event->type() == QEvent::ToolTip && m_pkBoneName->isVisible()) || QOpenGLWidget::event(event);
}

void CPreviewWidget::resizeEvent(QResizeEvent* event)
{
    QOpenGLWidget::resizeEvent(event);
    m_pkFollow->move(width() - m_pkFollow->width() - kTagMargin, kTagMargin);
    PlaceNote();
}

std::string CPreviewWidget::BoneAt(const QPointF& at) const
{
    if (!m_pkView || m_pkView->IsDragging())
        return {};
    return m_pkView->BoneAt({at.x(), at.y(), static_cast<double>(width()), static_cast<double>(height())});
}

void CPreviewWidget::NameBoneAt(const QPointF& at)
{
    const std::string bone = BoneAt(at);
    m_pkBoneName->setVisible(!bone.empty());
    if (bone.empty())
        return;
    m_pkBoneName->setText(ToQString(bone));
    m_pkBoneName->adjustSize();
    const int right = width() - m_pkBoneName->width();
    const int bottom = height() - m_pkBoneName->height();
    const QPoint beside = at.toPoint() + QPoint(2 * kTagMargin, 2 * kTagMargin);
    m_pkBoneName->move(std::clamp(beside.x(), 0, std::max(right, 0)),
                       beside.y() > bottom ? at.toPoint().y() - m_pkBoneName->height() : beside.y());
}

// A figure that plays moves away under the mouse.
void CPreviewWidget::ShowView()
{
    if (m_pkView && m_pkView->IsPlaying())
        m_pkBoneName->hide();
    update();
}

void CPreviewWidget::ShowNote(const QString& text)
{
    m_pkNote->setText(text);
    m_pkNote->setVisible(!text.isEmpty());
    PlaceNote();
}

void CPreviewWidget::PlaceNote()
{
    const int room = width() - 2 * kTagMargin;
    m_pkNote->setWordWrap(false);
    QSize size = m_pkNote->sizeHint();
    if (size.width() > room)
    {
        m_pkNote->setWordWrap(true);
        size = QSize(room, m_pkNote->heightForWidth(room));
    }
    m_pkNote->resize(size);
    m_pkNote->move(kTagMargin, height() - m_pkNote->height() - kTagMargin);
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
