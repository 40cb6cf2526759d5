// The profile editor's window. Most of the code deals with focus: a field is committed when it loses the
// keyboard, which also happens when a button is pressed, a message box opens or the window closes.

#include "CProfileEditorWindow.h"

#include "CBoneOffsetWindow.h"
#include "CBoneTreeView.h"
#include "CElidedLabel.h"
#include "CFieldEdit.h"
#include "CGaitConvertContent.h"
#include "CMapRowView.h"
#include "CProfileEditorDialog.h"
#include "QtText.h"
#include "WindowPlace.h"

#include <QGuiApplication>
#include <QKeyEvent>
#include <QPushButton>
#include <QShortcut>
#include <QTimer>
#include <utility>

namespace gw {

namespace {

constexpr const char* kPlaceSetting = "DialogPos";
// A stored position is used only if its size is this; a larger font makes the window larger.
constexpr QSize kTemplateSize(720, 640);

} // namespace

CProfileEditorWindow::CProfileEditorWindow(CGaitConvertContent& content, CPlatform& platform, QWidget* owner)
    : QDialog(owner), content_(content), platform_(platform), m_kControls(content, this)
{
    setObjectName(QStringLiteral("profileEditor"));
    setWindowTitle(tr("Profile Editor[*]"));
    ConnectFields();
    ConnectTrees();
    ConnectRows();
    ConnectButtons();
    AddShortcuts();
    m_kControls.m_pkSourceTree->setFocus();
}

// A visible window that is destroyed takes the focus from its fields, when their listeners are already gone.
CProfileEditorWindow::~CProfileEditorWindow()
{
    for (const auto& [id, edit] : m_kControls.m_kFields)
        edit->SetOnLeave({});
}

void CProfileEditorWindow::ConnectFields()
{
    for (const auto& [id, edit] : m_kControls.m_kFields)
    {
        connect(edit, &QLineEdit::textEdited, this,
                [this, id = id](const QString& text) { Model().EditField(id, ToUtf8(text)); });
        edit->SetOnLeave([this] { LeaveField(); });
    }
}

void CProfileEditorWindow::ConnectTrees()
{
    m_kControls.m_pkSourceTree->SetOnSelect([this](int item) { Model().SelectSourceItem(item); });
    m_kControls.m_pkTargetTree->SetOnSelect([this](int item) { Model().SelectTargetItem(item); });
    connect(m_kControls.m_pkFilter, &QLineEdit::textChanged, this, [this] { Refresh(); });
    m_kControls.m_pkFilter->SetOnEscape([this] { CloseFilter(); });
}

void CProfileEditorWindow::ConnectRows()
{
    m_kControls.m_pkRows->SetCallbacks({
        [this](int row, bool selected) { Model().SelectRow(row, selected); },
        [this](int row) { Model().ClickRow(row); },
        [this](int row) { Model().DoubleClickRow(row); },
    });
}

void CProfileEditorWindow::ConnectButtons()
{
    for (const CEditorControls::Button& button : m_kControls.m_kButtons)
        connect(button.button, &QPushButton::clicked, this,
                [this, id = button.id] { Model().ClickButton(id); });
}

void CProfileEditorWindow::AddShortcuts()
{
    const auto add = [this](const QKeySequence& keys, auto action) {
        connect(new QShortcut(keys, this), &QShortcut::activated, this, action);
    };
    add(Qt::CTRL | Qt::Key_F, [this] { OpenFilter(); });
    add(Qt::CTRL | Qt::Key_Z, [this] { Model().Undo(); });
    add(Qt::CTRL | Qt::SHIFT | Qt::Key_Z, [this] { Model().Redo(); });
    add(Qt::CTRL | Qt::Key_Y, [this] { Model().Redo(); });
}

CProfileEditorDialog& CProfileEditorWindow::Model() const
{
    return *content_.ProfileEditor();
}

// A message box takes the focus from the field that just received it; ignore that focus-out, it carries no
// edit.
void CProfileEditorWindow::LeaveField()
{
    if (std::exchange(m_bLeavingField, true))
        return;
    Model().LeaveField();
    m_bLeavingField = false;
    QTimer::singleShot(0, this, [this] { ReleaseButtons(); });
}

// Pressing a button makes a field lose the focus. If that shows a message box, the box gets the mouse release
// and the button would stay down.
void CProfileEditorWindow::ReleaseButtons()
{
    for (const CEditorControls::Button& button : m_kControls.m_kButtons)
    {
        if (QGuiApplication::mouseButtons() == Qt::NoButton)
            button.button->setDown(false);
    }
}

void CProfileEditorWindow::OpenFilter()
{
    m_kControls.m_pkFilterLine->show();
    m_kControls.m_pkFilter->setFocus();
    m_kControls.m_pkFilter->selectAll();
}

void CProfileEditorWindow::CloseFilter()
{
    m_kControls.m_pkFilter->clear();
    m_kControls.m_pkSourceTree->setFocus();
    m_kControls.m_pkFilterLine->hide();
}

void CProfileEditorWindow::SetShown(bool shown)
{
    if (!shown)
    {
        Hide();
        return;
    }
    if (!isVisible())
        RestorePlace();
    Redraw();
    show();
    raise();
    activateWindow();
}

void CProfileEditorWindow::RestorePlace()
{
    if (hiddenAt_)
    {
        resize(hiddenAt_->size());
        move(hiddenAt_->topLeft());
        return;
    }
    if (std::exchange(m_bPlaced, true))
        return;
    resize(kTemplateSize.expandedTo(minimumSizeHint()));
    if (const auto place = ReadWindowPlace(platform_, kPlaceSetting, size()))
        move(*place);
}

void CProfileEditorWindow::Hide()
{
    if (!isVisible())
        return;
    if (!isMinimized() && !isMaximized())
        hiddenAt_ = QRect(pos(), size());
    WriteWindowPlace(platform_, kPlaceSetting, *this);
    hide();
}

void CProfileEditorWindow::reject()
{
    setFocus();
    Hide();
    Model().Close();
}

// Enter commits a field without closing the window.
void CProfileEditorWindow::keyPressEvent(QKeyEvent* event)
{
    if (event->key() == Qt::Key_Return || event->key() == Qt::Key_Enter)
        setFocus();
    else
        QDialog::keyPressEvent(event);
}

bool CProfileEditorWindow::RunBoneOffset(CBoneOffsetDialog& dialog)
{
    CBoneOffsetWindow window(content_, dialog, isVisible() ? this : parentWidget());
    return window.exec() == Accepted;
}

// The model reports a change before it has updated its buttons, and often several times in a row.
void CProfileEditorWindow::Refresh()
{
    if (!isVisible() || std::exchange(m_bRedrawQueued, true))
        return;
    QTimer::singleShot(0, this, [this] {
        m_bRedrawQueued = false;
        Redraw();
    });
}

void CProfileEditorWindow::Redraw()
{
    ShowTrees();
    m_kControls.m_pkRows->ShowRows(Model().Rows());
    ShowFieldsAndButtons();
    ShowPair();
    setWindowModified(Model().IsDirty());
}

void CProfileEditorWindow::ShowTrees()
{
    const std::string filter = ToUtf8(m_kControls.m_pkFilter->text());
    m_kControls.m_pkSourceTree->ShowTree(Model().SourceTree(), filter);
    m_kControls.m_pkTargetTree->ShowTree(Model().TargetTree(), filter);
}

void CProfileEditorWindow::ShowFieldsAndButtons()
{
    for (const auto& [id, edit] : m_kControls.m_kFields)
        edit->ShowText(ToQString(Model().FieldText(id)));
    for (const CEditorControls::Button& button : m_kControls.m_kButtons)
        button.button->setEnabled(Model().Buttons().*button.enabled);
}

// Keeps the pair readable while the filter hides one of its bones.
void CProfileEditorWindow::ShowPair()
{
    const QString source = ToQString(Model().SourceTree().SelectedText());
    const QString target = ToQString(Model().TargetTree().SelectedText());
    const bool both = !source.isEmpty() && !target.isEmpty();
    const QString text =
        both ? source + QStringLiteral(" \u2192 ") + target : tr("Select a bone on each side.");
    m_kControls.m_pkPair->ShowText(text);
}

} // namespace gw
