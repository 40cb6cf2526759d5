#include "CDialogAnswers.h"

#include "QtText.h"

#include <QApplication>
#include <QMenu>
#include <QTest>
#include <QTimer>
#include <QWindow>
#include <gtest/gtest.h>
#include <utility>

namespace gw {
namespace {

constexpr int kPatience = 20'000; // milliseconds: other programs may have the processor
constexpr int kLookInterval = 20;

bool IsExposed(const QWidget& window)
{
    return window.isVisible() && window.windowHandle() && window.windowHandle()->isExposed();
}

// The toolkit's own wait treats a window as active while its owner is. The test screen has no window manager,
// so which window gets the keyboard when one closes is up to chance; request it again.
bool HasKeyboard(QWidget& window)
{
    const bool isActive = QApplication::activeWindow() == &window;
    if (!isActive)
        window.activateWindow();
    return isActive && IsExposed(window);
}

} // namespace

bool WaitUntil(const std::function<bool()>& holds)
{
    return QTest::qWaitFor(holds, kPatience);
}

void Activate(QWidget& window)
{
    EXPECT_TRUE(WaitUntil([&] { return HasKeyboard(window); })) << ToUtf8(window.windowTitle());
}

QMenu* OpenMenu()
{
    const auto menu = [] { return qobject_cast<QMenu*>(QApplication::activePopupWidget()); };
    EXPECT_TRUE(WaitUntil([&] { return menu() && IsExposed(*menu()); })) << "no menu opened";
    return menu();
}

void ClickInMenu(int row)
{
    QMenu* const menu = OpenMenu();
    ASSERT_TRUE(menu);
    QTest::mouseClick(menu, Qt::LeftButton, {}, menu->actionGeometry(menu->actions().at(row)).center());
}

CDialogAnswers::CDialogAnswers() : m_iPatience(kPatience)
{
    Look();
}

CDialogAnswers::CDialogAnswers(const std::function<void(QWidget& dialog)>& act) : CDialogAnswers()
{
    Add([act](QWidget& dialog) {
        act(dialog);
        return true;
    });
}

CDialogAnswers::~CDialogAnswers()
{
    EXPECT_EQ(m_kAnswers.size(), 0u) << "a window that was expected never came up";
}

// Schedules the next look first, because this one may run the next window's event loop before it returns.
void CDialogAnswers::Look()
{
    QTimer::singleShot(kLookInterval, this, [this] { Look(); });
    QWidget* const dialog = QApplication::activeModalWidget();
    if (dialog != m_kSeen)
    {
        m_kSeen = dialog;
        m_kSinceSeen.start();
        m_bAnswered = false;
    }
    if (!dialog)
        return;
    if (m_kSinceSeen.hasExpired(m_iPatience))
        CloseLeft(*dialog);
    else if (!m_bAnswered && !m_kAnswers.empty() && HasKeyboard(*dialog))
        Give(*dialog);
}

// Removed from the list first, for the same reason.
void CDialogAnswers::Give(QWidget& dialog)
{
    const Answer answer = std::move(m_kAnswers.front());
    m_kAnswers.erase(m_kAnswers.begin());
    m_bAnswered = true;
    if (answer(dialog))
        return;
    m_bAnswered = false;
    m_kAnswers.insert(m_kAnswers.begin(), answer);
}

// A test that has failed once does not wait again.
void CDialogAnswers::CloseLeft(QWidget& dialog)
{
    ADD_FAILURE() << "a window is left open: " << ToUtf8(dialog.windowTitle());
    m_iPatience = kLookInterval;
    m_kSinceSeen.start();
    dialog.close();
}

} // namespace gw
