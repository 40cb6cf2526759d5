#pragma once

#include <QElapsedTimer>
#include <QObject>
#include <QPoint>
#include <functional>

namespace gw {

/// Handles events before any window: Alt+F4, and the second click on the icon's corner, which closes the
/// program like a double click on a system menu.
class CMessageFilter : public QObject
{
public:
    /// Filters every event of the application, which must exist.
    explicit CMessageFilter(std::function<void()> requestClose);

    /// Remembers a click on the corner; another one at the same place within half a second closes the
    /// program.
    void RememberCorner(const QPoint& globalPosition);

    bool eventFilter(QObject* watched, QEvent* event) override;

private:
    bool IsCornerAgain(const QPoint& globalPosition) const;

    std::function<void()> requestClose_;
    QElapsedTimer m_kSinceCorner; ///< invalid if no click is remembered
    QPoint m_kCorner;
};

} // namespace gw
