// The map tool's window. It shows the tool's state after every operation and keeps none itself.

#include "CGaitToolWindow.h"

#include "CBoneTreeView.h"
#include "CMapLineDialog.h"
#include "CMotionPanel.h"
#include "FileDialog.h"
#include "ProfileNames.h"
#include "QtText.h"
#include "Text.h"

#include <QApplication>
#include <QContextMenuEvent>
#include <QKeyEvent>
#include <QLabel>
#include <QListView>
#include <QMenu>
#include <QPushButton>
#include <QScopedValueRollback>

namespace gw {

namespace {

constexpr size_t kShownCharacters = 300; // of a line; the rest is not useful in a list

// Returns a line for display in a list: shortened, and without characters that would break it.
QString ShownLine(const MapLine& line)
{
    return ToQString(Printable(FirstCharacters(line.text, kShownCharacters)));
}

} // namespace

CGaitToolWindow::CGaitToolWindow(const CPlatform& platform, const CLeftKeys& keys) : m_kTool(*this, platform)
{
    setObjectName(QStringLiteral("102"));
    setWindowTitle(QStringLiteral("GaitTool"));
    setWindowFlags(Qt::Window);
    MakeMenu();
    MakeLayout(keys);
    m_kClock.setInterval(CGaitToolDialog::kClockMilliseconds);
    m_kClock.setTimerType(Qt::PreciseTimer);
    connect(&m_kClock, &QTimer::timeout, this, [this] { Tick(); });
    m_kTool.OnInitDialog();
    Refresh();
}

CGaitToolWindow::~CGaitToolWindow() = default;

// ---- user actions

void CGaitToolWindow::Forward(const std::function<void()>& operation)
{
    operation();
    Refresh();
}

// Showing a selection must not count as making one.
void CGaitToolWindow::SelectLine(const QModelIndex& line)
{
    if (!m_bShowing)
        Forward([&] { m_kTool.SelectLine(line.row()); });
}

void CGaitToolWindow::Click(int id)
{
    Forward([&] { m_kTool.ClickButton(id); });
}

// The result has the target's bones.
void CGaitToolWindow::ClickBone(EToolMotion motion, const std::string& bone)
{
    if (motion == EToolMotion::Source)
        Forward([&] { m_kTool.SelectSourceItem(m_kTool.SourceTree().Find(bone)); });
    else
        Forward([&] { m_kTool.SelectTargetItem(m_kTool.TargetTree().Find(bone)); });
}

void CGaitToolWindow::Tick()
{
    if (!m_kTool.Advance())
        m_kClock.stop();
    ShowFrames();
}

void CGaitToolWindow::contextMenuEvent(QContextMenuEvent* event)
{
    m_pkMenu->popup(event->globalPos());
}

// A dialog's Escape key would end the program with an unsaved map.
void CGaitToolWindow::keyPressEvent(QKeyEvent* event)
{
    if (event->key() == Qt::Key_Escape)
        event->ignore();
    else
        QDialog::keyPressEvent(event);
}

// ---- questions from the tool

std::optional<std::string> CGaitToolWindow::AskOpenFile(const FileDialogSetup& setup)
{
    return RunFileDialog(*this, QFileDialog::AcceptOpen, setup);
}

std::optional<std::string> CGaitToolWindow::AskSaveFile(const FileDialogSetup& setup)
{
    return RunFileDialog(*this, QFileDialog::AcceptSave, setup);
}

bool CGaitToolWindow::EditLine(MapLine& line)
{
    CMapLineDialog dialog(line, this);
    if (dialog.exec() != QDialog::Accepted)
        return false;
    line = dialog.Line();
    return true;
}

std::unique_ptr<CMotionView> CGaitToolWindow::CreateView(EToolMotion motion)
{
    return Panel(motion).MakeView();
}

void CGaitToolWindow::BeginWaitCursor()
{
    QApplication::setOverrideCursor(Qt::WaitCursor);
}

void CGaitToolWindow::EndWaitCursor()
{
    QApplication::restoreOverrideCursor();
}

// ---- display

void CGaitToolWindow::Refresh()
{
    for (QPushButton* button : m_kButtons)
        button->setEnabled(m_kTool.IsEnabled(button->objectName().toInt()));
    m_pkSourceTree->ShowTree(m_kTool.SourceTree(), {});
    m_pkTargetTree->ShowTree(m_kTool.TargetTree(), {});
    ShowLines();
    ShowFrames();
    m_pkStatus->setText(ToQString(m_kTool.Status()));
    m_pkStatus->setToolTip(m_pkStatus->text());
    if (m_kTool.IsPlaying() && !m_kClock.isActive())
        m_kClock.start();
}

void CGaitToolWindow::ShowFrames()
{
    for (const EToolMotion motion : kToolMotions)
    {
        if (m_kTool.Motion(motion).motionRoot)
            Panel(motion).ShowFrame(m_kTool.FrameOf(motion), m_kTool.LastFrameOf(motion));
    }
}

void CGaitToolWindow::ShowLines()
{
    const CMapLineList& map = m_kTool.Map();
    QStringList texts;
    for (const MapLine& line : map.Lines())
        texts << ShownLine(line);
    const QScopedValueRollback showing(m_bShowing, true);
    const bool grew = texts.size() > m_kLineTexts.rowCount();
    if (m_kLineTexts.stringList() != texts)
        m_kLineTexts.setStringList(texts);
    const QModelIndex selected = m_kLineTexts.index(map.Selected());
    m_pkLines->setCurrentIndex(selected);
    if (!selected.isValid())
        m_pkLines->clearSelection();
    if (grew)
        m_pkLines->scrollToBottom();
}

} // namespace gw
