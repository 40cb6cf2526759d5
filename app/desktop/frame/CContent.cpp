// The face creates its children from the skin, finds the ones that the program needs by name, and connects
// them to the conversion. Operations block the event loop, so progress and status are painted directly while
// one is running.

#include "CContent.h"

#include "CElidedLabel.h"
#include "CGLView.h"
#include "CGaitConvertContent.h"
#include "CInputGate.h"
#include "CLeftKeys.h"
#include "CPlaybar.h"
#include "CPreviewWidget.h"
#include "CProfileEditorWindow.h"
#include "CTitleLabel.h"
#include "FaceChildren.h"
#include "FindingWords.h"
#include "QtText.h"
#include "StringTable.h"

#include <QApplication>
#include <QComboBox>
#include <QCoreApplication>
#include <QMouseEvent>

namespace gw {

namespace {

constexpr int kProgressMilliseconds = 100; // shorter operations show no progress
constexpr int kCornerSide = 32;            // side of the icon's corner, in pixels

} // namespace

CContent::CContent(const CSkin& skin, const CLeftKeys& keys, QWidget* frame) : QWidget(frame), keys_(keys)
{
    setObjectName(QStringLiteral("face"));
    setAttribute(Qt::WA_StyledBackground);
    setFixedSize(skin.Size());
    for (const SkinChild& child : skin.Children())
    {
        QWidget* const widget = MakeFaceChild(child, skin, keys, this);
        m_kChildren[child.name] = widget;
        Connect(*widget);
    }
    ConnectMarks();
    ShowNoteCount();
    connect(qApp, &QApplication::focusChanged, this, [this] { update(); });
}

CContent::~CContent() = default;

// Returns the child with a name, or null if it is missing or of another type.
template <class Widget>
Widget* CContent::Child(std::string_view name) const
{
    const auto found = m_kChildren.find(name);
    return found == m_kChildren.end() ? nullptr : dynamic_cast<Widget*>(found->second);
}

void CContent::Connect(QWidget& child)
{
    if (auto* button = dynamic_cast<CFaceButton*>(&child))
        connect(button, &QPushButton::clicked, this, [this, button] { Click(ToUtf8(button->objectName())); });
    else if (auto* title = dynamic_cast<CTitleLabel*>(&child))
        title->mouseDown = [this](const QPoint& position) { titleDown(position); };
    else if (child.property("kind").toString() == QLatin1String("view"))
        MakeHint(&child);
    else
        ConnectBar(&child);
}

void CContent::ConnectBar(QWidget* child)
{
    auto* const bar = dynamic_cast<CPlaybar*>(child);
    if (!bar)
        return;
    const std::string name = ToUtf8(bar->objectName());
    bar->mouseDown = [this, name] { m_pkLogic->ChildMouseDown(name); };
    bar->scroll = [this, name](int value) { m_pkLogic->ChildScroll(name, value); };
    bar->mouseUp = [this, name] { m_pkLogic->ChildMouseUp(name); };
}

void CContent::Click(const std::string& child)
{
    if (child == "minimise")
        window()->showMinimized();
    else if (child == "options")
        options(Child<QWidget>(child)->mapToGlobal(QPoint(0, 0)));
    else if (child == "notes")
        ShowNotes();
    else if (m_pkLogic)
        m_pkLogic->ChildClick(child);
}

bool CContent::IsBusy() const
{
    return m_iWaits > 0 || QApplication::activeModalWidget();
}

void CContent::FrameAll()
{
    for (const char* name : {"#cnt1", "#cnt2"})
    {
        auto* const surface = Child<CPreviewWidget>(name);
        if (!surface || !surface->View())
            continue;
        surface->View()->FrameAll();
        surface->View()->Repaint();
    }
}

void CContent::mousePressEvent(QMouseEvent* event)
{
    const QPoint place = event->position().toPoint();
    if (event->button() == Qt::LeftButton && place.x() < kCornerSide && place.y() < kCornerSide)
        cornerDown(event->globalPosition().toPoint());
}

bool CContent::IsKeyDown(EKey key) const
{
    return keys_.IsDown(key);
}

void CContent::Notify(const Notice& notice)
{
    m_kNotices.push_back(notice);
}

// One line per notice.
std::string CContent::Notes() const
{
    std::string text;
    for (const Notice& notice : m_kNotices)
    {
        if (!text.empty())
            text += '\n';
        text += NoticeLine(notice);
    }
    return text;
}

void CContent::ShowNoteCount()
{
    auto* const button = Child<QPushButton>("notes");
    if (!button)
        return;
    const auto count = static_cast<int>(m_kNotices.size());
    button->setText(count == 1 ? tr(" 1 note") : tr(" %1 notes").arg(count));
    button->setVisible(count > 0);
}

bool CContent::IsProgressDue()
{
    return m_iWaits > 0 && m_kSincePainted.hasExpired(kProgressMilliseconds);
}

void CContent::StayPainted()
{
    const CInputGate gate;
    QCoreApplication::processEvents(QEventLoop::ExcludeSocketNotifiers);
    m_bCancelRequested = m_bCancelRequested || gate.WasEscapePressed();
    m_kSincePainted.start();
}

void CContent::BeginWaitCursor()
{
    if (m_iWaits++ > 0)
        return;
    m_kNotices.clear();
    m_bCancelRequested = false;
    ShowNoteCount();
    m_kSincePainted.start();
    QGuiApplication::setOverrideCursor(Qt::WaitCursor);
}

void CContent::EndWaitCursor()
{
    if (--m_iWaits > 0)
        return;
    QGuiApplication::restoreOverrideCursor();
    ShowNoteCount();
}

void CContent::RedrawFrame()
{
    window()->repaint();
}

void CContent::PostCloseRequest()
{
    QMetaObject::invokeMethod(window(), &QWidget::close, Qt::QueuedConnection);
}

void CContent::EnableChild(std::string_view child, bool on)
{
    auto* const widget = Child<QWidget>(child);
    if (!widget)
        return;
    const bool loses = !on && widget->isEnabled() && window()->focusWidget() == widget;
    widget->setEnabled(on);
    if (loses)
        FocusView();
}

void CContent::SetChildFace(std::string_view child, int face)
{
    if (auto* button = Child<CFaceButton>(child))
        button->SetFace(face);
}

void CContent::SetChildButtonState(std::string_view child, bool on)
{
    if (auto* button = Child<QAbstractButton>(child))
        button->setChecked(on);
}

bool CContent::GetChildButtonState(std::string_view child) const
{
    const auto* button = Child<QAbstractButton>(child);
    return button && button->isChecked();
}

void CContent::SetChildScrollRange(std::string_view child, int low, int high)
{
    if (auto* bar = Child<QSlider>(child))
        bar->setRange(low, high);
}

void CContent::SetChildScrollValue(std::string_view child, int value)
{
    if (auto* bar = Child<QSlider>(child); bar && !bar->isSliderDown())
        bar->setValue(value);
}

void CContent::SetChildText(std::string_view child, const std::string& text)
{
    if (auto* title = Child<CTitleLabel>(child))
        title->ShowAtOnce(ToQString(text));
    else if (auto* caption = Child<CElidedLabel>(child))
        caption->ShowText(ToQString(text));
}

void CContent::SetChildTip(std::string_view child, const std::string& text)
{
    if (auto* widget = Child<QWidget>(child))
        widget->setToolTip(ToQString(text));
}

std::unique_ptr<CMotionView> CContent::CreateView(std::string_view child)
{
    auto* const surface = Child<CPreviewWidget>(child);
    if (!surface)
        return nullptr;
    surface->follow = [this](bool on) { m_pkLogic->SetFollow(on); };
    surface->clickBone = [this, name = std::string(child)](const std::string& bone) {
        m_pkLogic->ClickBone(name, bone);
    };
    return surface->MakeView();
}

CCntComboExControl& CContent::CreateComboEx(std::string_view field, std::string_view arrow, int fontSize)
{
    m_kCombo.SetChildren(Child<QComboBox>(field), Child<QAbstractButton>(arrow), fontSize);
    m_kCombo.SetNotify([this](int code) { m_pkLogic->OnCntCommand(code); });
    return m_kCombo;
}

// Ticks during an operation are dropped, as if it had blocked the event loop.
void CContent::SetTimer(int id, int milliseconds)
{
    std::unique_ptr<QTimer>& timer = m_kTimers[id];
    if (!timer)
    {
        timer = std::make_unique<QTimer>();
        timer->setTimerType(Qt::PreciseTimer);
        connect(timer.get(), &QTimer::timeout, this, [this, id] {
            if (m_pkLogic && m_iWaits == 0)
                m_pkLogic->OnTimer(id);
        });
    }
    timer->start(milliseconds);
}

void CContent::KillTimer(int id)
{
    if (const auto found = m_kTimers.find(id); found != m_kTimers.end())
        found->second->stop();
}

void CContent::ShowProfileEditor(bool visible)
{
    if (m_pkEditor)
        m_pkEditor->SetShown(visible);
}

void CContent::RefreshProfileEditor()
{
    if (m_pkEditor)
        m_pkEditor->Refresh();
}

bool CContent::RunBoneOffset(CBoneOffsetDialog& dialog)
{
    return m_pkEditor && m_pkEditor->RunBoneOffset(dialog);
}

} // namespace gw
