#pragma once

#include <QElapsedTimer>
#include <QObject>
#include <QPointer>
#include <QWidget>
#include <functional>
#include <vector>

class QMenu;

namespace gw {

/// Lets the program run until something holds; false after twenty seconds.
bool WaitUntil(const std::function<bool()>& holds);
/// Gives a window the keyboard and lets the program run until the window has it. Without it keys are lost.
void Activate(QWidget& window);
/// Waits for the menu that was asked for; null, and the test fails, where none opens.
QMenu* OpenMenu();
/// Clicks an entry of that menu.
void ClickInMenu(int row);

/// What a person does with the modal windows that come up, within whatever loop of events. Each answer is for
/// one window, in this order, and waits until the window stands there and has the keyboard. A window that
/// nobody answers, or that its answer leaves open, fails the test and is closed, so that no test hangs.
class CDialogAnswers : public QObject
{
public:
    /// Ends a window; false, and nothing done, where it is not the one that the answer is for.
    using Answer = std::function<bool(QWidget& dialog)>;

    CDialogAnswers();
    /// With an answer that suits any window.
    explicit CDialogAnswers(const std::function<void(QWidget& dialog)>& act);
    /// A test fails whose windows did not all come up.
    ~CDialogAnswers() override;

    void Add(Answer answer) { m_kAnswers.push_back(std::move(answer)); }

private:
    void Look();
    void Give(QWidget& dialog);
    void CloseLeft(QWidget& dialog);

    std::vector<Answer> m_kAnswers;
    QPointer<QWidget> m_kSeen;
    QElapsedTimer m_kSinceSeen;
    int m_iPatience;
    bool m_bAnswered = false; // the seen one
};

} // namespace gw
