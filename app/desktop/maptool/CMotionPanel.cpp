// A preview panel of the map tool. Without OpenGL, it has a caption and buttons but no picture.

#include "CMotionPanel.h"

#include "CGaitToolDialog.h"
#include "CIconButton.h"
#include "CPreviewWidget.h"
#include "QtText.h"

#include <QCoreApplication>
#include <QDragEnterEvent>
#include <QDropEvent>
#include <QHBoxLayout>
#include <QLabel>
#include <QMimeData>
#include <QUrl>
#include <QVBoxLayout>

namespace gw {

namespace {

constexpr const char* kContext = "GaitTool";
constexpr int kPictureSide = 200;
constexpr int kPanelGap = 6;

// Indexed by EToolMotion.
constexpr const char* kCaptions[] = {
    QT_TRANSLATE_NOOP("GaitTool", "Source"),
    QT_TRANSLATE_NOOP("GaitTool", "Target"),
    QT_TRANSLATE_NOOP("GaitTool", "Result"),
};

struct TransportButton
{
    EButtonIcon m_eIcon;
    const char* m_pcName;
};

// In kTransportIds order.
constexpr TransportButton kTransportButtons[] = {
    {EButtonIcon::SeekStart,   QT_TRANSLATE_NOOP("GaitTool", "First frame")   },
    {EButtonIcon::StepBack,    QT_TRANSLATE_NOOP("GaitTool", "Previous frame")},
    {EButtonIcon::Stop,        QT_TRANSLATE_NOOP("GaitTool", "Stop")          },
    {EButtonIcon::Play,        QT_TRANSLATE_NOOP("GaitTool", "Play")          },
    {EButtonIcon::StepForward, QT_TRANSLATE_NOOP("GaitTool", "Next frame")    },
};

QString CaptionOf(EToolMotion motion)
{
    return QCoreApplication::translate(kContext, kCaptions[static_cast<size_t>(motion)]);
}

// Returns the first motion file in dragged data; empty if there is none.
QString MotionFileOf(const QMimeData& mime)
{
    for (const QUrl& url : mime.urls())
    {
        QString path = url.toLocalFile();
        if (CGaitToolDialog::TakesFile(ToUtf8(path)))
            return path;
    }
    return {};
}

} // namespace

CMotionPanel::CMotionPanel(EToolMotion motion, const CLeftKeys& keys, QWidget* parent)
    : QWidget(parent), m_eMotion(motion)
{
    setObjectName(QStringLiteral("panel%1").arg(static_cast<int>(motion)));
    setAccessibleName(CaptionOf(motion));
    auto* const layout = new QVBoxLayout(this);
    layout->setContentsMargins(0, 0, 0, 0);
    layout->setSpacing(kPanelGap);
    layout->addLayout(MakeCaption());
    layout->addWidget(MakePicture(keys), 1);
    layout->addLayout(MakeTransport());
}

QLayout* CMotionPanel::MakeCaption()
{
    auto* const caption = new QLabel(CaptionOf(m_eMotion), this);
    caption->setObjectName(objectName() + QStringLiteral("Caption"));
    caption->setProperty("kind", QStringLiteral("text"));
    m_pkFrame = new QLabel(this);
    m_pkFrame->setObjectName(objectName() + QStringLiteral("Frame"));
    m_pkFrame->setProperty("kind", QStringLiteral("value"));
    auto* const row = new QHBoxLayout;
    row->addWidget(caption);
    row->addStretch();
    row->addWidget(m_pkFrame);
    return row;
}

QWidget* CMotionPanel::MakePicture(const CLeftKeys& keys)
{
    QWidget* picture = nullptr;
    if (HasOpenGL())
        picture = m_pkPreview = new CPreviewWidget(keys, this);
    else
    {
        auto* const label =
            new QLabel(QCoreApplication::translate(kContext, "OpenGL is missing: no preview"), this);
        label->setAlignment(Qt::AlignCenter);
        label->setProperty("kind", QStringLiteral("view"));
        picture = label;
    }
    picture->setObjectName(objectName() + QStringLiteral("View"));
    picture->setAccessibleName(CaptionOf(m_eMotion));
    picture->setMinimumSize(kPictureSide, kPictureSide);
    picture->setSizePolicy(QSizePolicy::Expanding, QSizePolicy::Expanding);
    return picture;
}

QLayout* CMotionPanel::MakeTransport()
{
    auto* const row = new QHBoxLayout;
    row->setSpacing(kPanelGap);
    row->addStretch();
    const int* id = kTransportIds[static_cast<size_t>(m_eMotion)];
    for (const auto& [icon, name] : kTransportButtons)
    {
        auto* const button = new CIconButton(icon, QCoreApplication::translate(kContext, name), this);
        button->setObjectName(QString::number(*id));
        connect(button, &QPushButton::clicked, this, [this, id = *id] { clicked_(id); });
        row->addWidget(button);
        ++id;
    }
    row->addStretch();
    return row;
}

std::unique_ptr<CMotionView> CMotionPanel::MakeView()
{
    if (m_pkPreview)
        return m_pkPreview->MakeView();
    return std::make_unique<CGLView>();
}

void CMotionPanel::ShowFrame(int frame, int lastFrame)
{
    m_pkFrame->setText(QCoreApplication::translate(kContext, "frame %1 of %2").arg(frame).arg(lastFrame));
}

void CMotionPanel::SetBoneClicked(std::function<void(const std::string& bone)> clicked)
{
    if (m_pkPreview)
        m_pkPreview->clickBone = std::move(clicked);
}

void CMotionPanel::SetDropped(std::function<void(const QString&)> dropped)
{
    dropped_ = std::move(dropped);
    setAcceptDrops(true);
}

void CMotionPanel::dragEnterEvent(QDragEnterEvent* event)
{
    if (!MotionFileOf(*event->mimeData()).isEmpty())
        event->acceptProposedAction();
}

void CMotionPanel::dropEvent(QDropEvent* event)
{
    event->acceptProposedAction();
    dropped_(MotionFileOf(*event->mimeData()));
}

} // namespace gw
