// The frameless main window: moves with the mouse on its title, restores its position, and maps keys to the
// controls of its face.

#include "CGaitConvertFrame.h"

#include "CContent.h"
#include "CGaitConvertContent.h"
#include "CPlatform.h"
#include "CProfileEditorWindow.h"
#include "CSkin.h"
#include "CornerMenu.h"
#include "OptionsMenu.h"
#include "QtText.h"
#include "StringTable.h"
#include "WindowPlace.h"

#include <QAbstractButton>
#include <QApplication>
#include <QCloseEvent>
#include <QDragEnterEvent>
#include <QKeyCombination>
#include <QKeySequence>
#include <QMimeData>
#include <QMouseEvent>
#include <QScreen>
#include <QShortcut>
#include <QTimer>
#include <QUrl>
#include <QWindow>

namespace gw {

namespace {

constexpr const char* kPlaceSetting = "WindowPos";
constexpr int kMenuMilliseconds = 5;
constexpr int kRetryMilliseconds = 200;

// Keys that click a widget.
struct Key
{
    QKeyCombination keys;
    const char* child;
};
constexpr Key kKeys[] = {
    {Qt::CTRL | Qt::Key_Return, "convert"},
    {Qt::CTRL | Qt::Key_Enter,  "convert"},
    {Qt::CTRL | Qt::Key_S,      "apply"  },
    {Qt::Key_Space,             "play"   },
    {Qt::Key_Home,              "back"   },
    {Qt::Key_End,               "end"    },
    {Qt::Key_Left,              "fback"  },
    {Qt::Key_Right,             "fend"   },
    {Qt::Key_F1,                "help"   },
};

std::string DroppedPath(const QMimeData& dropped)
{
    for (const QUrl& address : dropped.urls())
    {
        if (address.isLocalFile())
            return ToUtf8(address.toLocalFile());
    }
    return {};
}

} // namespace

CGaitConvertFrame::CGaitConvertFrame(const CSkin& skin, const CLeftKeys& keys, CPlatform& platform)
    : QWidget(nullptr, Qt::Window | Qt::FramelessWindowHint), platform_(platform),
      m_pkFace(new CContent(skin, keys, this)),
      m_spContent(std::make_unique<CGaitConvertContent>(*m_pkFace, platform)),
      m_kFilter([this] { m_pkFace->PostCloseRequest(); })
{
    m_pkFace->SetLogic(m_spContent.get());
    m_pkFace->titleDown = [this](const QPoint& position) { BeginMove(position); };
    m_pkFace->cornerDown = [this](const QPoint& position) { OpenCornerMenu(position); };
    m_pkFace->options = [this](const QPoint& place) {
        QMenu* const menu = MakeOptionsMenu(*m_spContent, this);
        menu->popup(place - QPoint(0, menu->sizeHint().height()));
    };
    m_spContent->OnInitContent();
    m_spContent->SetTitle({});
    m_pkEditor = new CProfileEditorWindow(*m_spContent, platform, this);
    m_pkFace->SetEditor(m_pkEditor);
    setWindowTitle(ToQString(m_spContent->Message(kTitleMessage)));
    setWindowIcon(skin.Icon("logo"));
    setAcceptDrops(true);
    Place(skin.Size());
    AddShortcuts();
    if (auto* open = findChild<QWidget*>(QStringLiteral("open")))
        open->setFocus();
}

// Face and editor refer to the conversion until they are destroyed.
CGaitConvertFrame::~CGaitConvertFrame()
{
    delete m_pkEditor;
    m_pkFace->SetEditor(nullptr);
    m_pkFace->SetLogic(nullptr);
    m_spContent.reset();
}

// A stored position is used only if the window is visible there; the size is always the skin's.
void CGaitConvertFrame::Place(const QSize& size)
{
    setFixedSize(size);
    if (const auto place = ReadWindowPlace(platform_, kPlaceSetting))
        move(*place);
    else if (const QScreen* screen = QGuiApplication::primaryScreen())
        move(screen->availableGeometry().center() - rect().center());
}

void CGaitConvertFrame::AddShortcuts()
{
    const auto add = [this](QKeyCombination keys, auto run) {
        connect(new QShortcut(QKeySequence(keys), this), &QShortcut::activated, this, run);
    };
    for (const Key& key : kKeys)
    {
        auto* const button = findChild<QAbstractButton*>(QLatin1String(key.child));
        add(key.keys, [button] { button->click(); });
    }
    // Not a click: with the left Ctrl key, that would start a batch run.
    add(Qt::CTRL | Qt::Key_O, [this] { m_spContent->OpenSource(); });
    add(QKeyCombination(Qt::Key_T), [this] { m_spContent->SetFollow(!m_spContent->IsFollowing()); });
    add(QKeyCombination(Qt::Key_N), [this] { m_spContent->GoToNextWorst(); });
    add(Qt::CTRL | Qt::Key_M, [this] { m_spContent->TakeOffer(); });
    add(QKeyCombination(Qt::Key_F), [this] { m_pkFace->FrameAll(); });
}

void CGaitConvertFrame::OpenSoon(const std::string& path)
{
    const bool busy = m_pkFace->IsBusy();
    QTimer::singleShot(busy ? kRetryMilliseconds : 0, this, [this, path] {
        if (m_pkFace->IsBusy())
            OpenSoon(path);
        else
            m_spContent->OpenDropped(path);
    });
}

void CGaitConvertFrame::RaiseAndOpen(const std::string& path)
{
    if (isMinimized())
        showNormal();
    raise();
    activateWindow();
    if (!path.empty())
        OpenSoon(path);
}

void CGaitConvertFrame::closeEvent(QCloseEvent* event)
{
    if (QWidget* field = QApplication::focusWidget())
        field->clearFocus(); // commits the text being typed
    if (m_pkFace->IsBusy() || !m_spContent->MayClose())
    {
        event->ignore();
        return;
    }
    WriteWindowPlace(platform_, kPlaceSetting, *this);
    m_pkEditor->close();
    event->accept();
    QCoreApplication::quit();
}

void CGaitConvertFrame::BeginMove(const QPoint& globalPosition)
{
    if (windowHandle() && windowHandle()->startSystemMove())
        return;
    grip_ = globalPosition - pos();
    grabMouse();
}

void CGaitConvertFrame::mouseMoveEvent(QMouseEvent* event)
{
    if (grip_)
        move(event->globalPosition().toPoint() - *grip_);
}

void CGaitConvertFrame::mouseReleaseEvent(QMouseEvent*)
{
    if (grip_)
        releaseMouse();
    grip_.reset();
}

void CGaitConvertFrame::OpenCornerMenu(const QPoint& globalPosition)
{
    m_kFilter.RememberCorner(globalPosition);
    QTimer::singleShot(kMenuMilliseconds, this, [this, globalPosition] {
        QMenu* const menu = MakeCornerMenu(*this);
        menu->popup(globalPosition);
    });
}

void CGaitConvertFrame::dragEnterEvent(QDragEnterEvent* event)
{
    if (!DroppedPath(*event->mimeData()).empty() && !m_pkFace->IsBusy())
        event->acceptProposedAction();
}

void CGaitConvertFrame::dropEvent(QDropEvent* event)
{
    event->acceptProposedAction();
    OpenSoon(DroppedPath(*event->mimeData()));
}

} // namespace gw
