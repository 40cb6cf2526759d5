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
#include "PairText.h"
#include "PlaceBeside.h"
#include "QtText.h"
#include "WindowPlace.h"

#include <QAbstractButton>
#include <QGuiApplication>
#include <QKeyEvent>
#include <QPushButton>
#include <QScopedValueRollback>
#include <QShortcut>
#include <QTimer>
#include <algorithm>
#include <utility>

namespace gw {

namespace {

constexpr const char* kPlaceSetting = "DialogPos";
// A stored position is used only if its size is this; a larger font makes the window larger.
constexpr QSize kTemplateSize(720, 640);
// The editor's messages, from the limits of a number to the question before a file is replaced.
constexpr int kFirstMessage = 157;
constexpr int kLastMessage = 163;

bool IsEnter(const QKeyEvent& event)
{
    return event.key() == Qt::Key_Return || event.key() == Qt::Key_Enter;
}

} // namespace

CProfileEditorWindow::CProfileEditorWindow(CGaitConvertContent& content, CPlatform& platform, QWidget* owner)
    : QDialog(owner), content_(content), platform_(platform), m_kControls(content, this)
{
    setObjectName(QStringLiteral("profileEditor"));
    setWindowTitle(tr("Bone Map Editor[*]"));
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
    for (const CEditorControls::Search& search : m_kControls.m_kSearches)
        connect(search.edit, &QLineEdit::textChanged, this, [this] { Refresh(); });
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
    add(Qt::CTRL | Qt::Key_F, [this] { OpenSearch(); });
    add(Qt::CTRL | Qt::Key_Z, [this] { Model().Undo(); });
    add(Qt::CTRL | Qt::SHIFT | Qt::Key_Z, [this] { Model().Redo(); });
    add(Qt::CTRL | Qt::Key_Y, [this] { Model().Redo(); });
    add(Qt::CTRL | Qt::Key_Return, [this] { ClickInOwner("convert"); });
    add(Qt::CTRL | Qt::Key_Enter, [this] { ClickInOwner("convert"); });
    add(Qt::CTRL | Qt::Key_S, [this] { ClickInOwner("apply"); });
    auto* const remove =
        new QShortcut(QKeySequence::Delete, m_kControls.m_pkRows, nullptr, nullptr, Qt::WidgetShortcut);
    connect(remove, &QShortcut::activated, this, [this] { Model().ClickButton(kRemoveButton); });
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

// Returns the search whose field or tree has the keyboard, or null.
const CEditorControls::Search* CProfileEditorWindow::FocusedSearch() const
{
    const auto hasFocus = [](const auto& search) {
        return search.edit->hasFocus() || search.tree->hasFocus();
    };
    const auto found = std::ranges::find_if(m_kControls.m_kSearches, hasFocus);
    return found == m_kControls.m_kSearches.end() ? nullptr : &*found;
}

// A second Ctrl+F searches the other tree.
void CProfileEditorWindow::OpenSearch()
{
    const CEditorControls::Search& source = m_kControls.m_kSearches.front();
    const CEditorControls::Search& target = m_kControls.m_kSearches.back();
    CFieldEdit* const edit = target.tree->hasFocus() || source.edit->hasFocus() ? target.edit : source.edit;
    edit->setFocus();
    edit->selectAll();
}

// Selects a match and shows the whole tree around it. Returns false if the keyboard is not in a search.
bool CProfileEditorWindow::AcceptSearch()
{
    const CEditorControls::Search* const search = FocusedSearch();
    if (!search || search->edit->text().isEmpty())
        return false;
    Redraw(); // keys can arrive faster than the list is updated
    if (search->tree->hasFocus() || search->tree->SelectFirst())
    {
        search->tree->setFocus();
        search->edit->clear();
    }
    return true;
}

// Returns whether a search was cleared.
bool CProfileEditorWindow::ClearSearch()
{
    bool cleared = false;
    for (const CEditorControls::Search& search : m_kControls.m_kSearches)
    {
        cleared = cleared || !search.edit->text().isEmpty();
        search.edit->clear();
    }
    return cleared;
}

void CProfileEditorWindow::EnterResults()
{
    const CEditorControls::Search* const search = FocusedSearch();
    Redraw();
    if (search && search->edit->hasFocus() && search->tree->SelectFirst())
        search->tree->setFocus();
}

// The typing in a field counts for a conversion, as if the button had been clicked with the mouse.
void CProfileEditorWindow::ClickInOwner(const char* child)
{
    LeaveField();
    const QScopedValueRollback clicking(m_bClickingInOwner, true);
    if (auto* const button = parentWidget()->findChild<QAbstractButton*>(QLatin1String(child)))
        button->click();
}

bool CProfileEditorWindow::Raised(int messageId) const
{
    const bool isOwn = messageId >= kFirstMessage && messageId <= kLastMessage;
    return isVisible() && (isOwn || m_bClickingInOwner);
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
    else
        PlaceBeside(*this, *parentWidget()->window());
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

// Enter accepts a search or commits a field; it never closes the window. Escape clears a search first.
void CProfileEditorWindow::keyPressEvent(QKeyEvent* event)
{
    if (IsEnter(*event))
    {
        if (!AcceptSearch())
            setFocus();
    }
    else if (event->key() == Qt::Key_Down)
        EnterResults();
    else if (event->key() != Qt::Key_Escape || !ClearSearch())
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
    const auto& searches = m_kControls.m_kSearches;
    m_kControls.m_pkSourceTree->ShowTree(Model().SourceTree(), ToUtf8(searches.front().edit->text()));
    m_kControls.m_pkTargetTree->ShowTree(Model().TargetTree(), ToUtf8(searches.back().edit->text()));
    for (const CEditorControls::Search& search : searches)
        search.edit->ShowFailure(!search.edit->text().isEmpty() && search.tree->topLevelItemCount() == 0);
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
    const std::string& source = Model().SourceTree().SelectedText();
    const std::string& target = Model().TargetTree().SelectedText();
    const bool both = !source.empty() && !target.empty();
    m_kControls.m_pkPair->ShowText(both ? PairText(source, target) : tr("Select a bone on each side."));
}

} // namespace gw
