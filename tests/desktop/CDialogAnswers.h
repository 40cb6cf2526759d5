#pragma once

#include <QElapsedTimer>
#include <QObject>
#include <QPointer>
#include <QWidget>
#include <functional>
#include <vector>

class QMenu;

namespace gw {

/// Runs the program until a condition holds; returns false after twenty seconds.
bool WaitUntil(const std::function<bool()>& holds);
/// Gives a window the keyboard and waits until it has it. Otherwise keys would be lost.
void Activate(QWidget& window);
/// Waits for the requested menu; if none opens, returns null and the test fails.
QMenu* OpenMenu();
/// Clicks an entry of that menu.
void ClickInMenu(int row);

/// Answers modal windows like a user, in any event loop. Each answer is for one window, in order, and waits
/// until the window is shown and has the keyboard. A window without an answer, or one that its answer does
/// not close, fails the test and is closed, so that tests never hang.
class CDialogAnswers : public QObject
{
public:
    /// Closes a window; returns false, and does nothing, if the answer is for another window.
    using Answer = std::function<bool(QWidget& dialog)>;

    CDialogAnswers();
    /// Starts with an answer for any window.
    explicit CDialogAnswers(const std::function<void(QWidget& dialog)>& act);
    /// Fails the test if expected windows did not open.
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
    bool m_bAnswered = false; // the window that was seen last
};

} // namespace gw
