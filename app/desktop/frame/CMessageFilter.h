#pragma once

#include <QElapsedTimer>
#include <QObject>
#include <QPoint>
#include <functional>

namespace gw {

/// What the application looks at before any window does: Alt+F4, and the second click on the icon's corner,
/// which closes as a double click on a system menu does.
class CMessageFilter : public QObject
{
public:
    /// Watches every event of the application, which must exist.
    explicit CMessageFilter(std::function<void()> requestClose);

    /// The corner was clicked: a click on the same place within half a second closes.
    void RememberCorner(const QPoint& globalPosition);

    bool eventFilter(QObject* watched, QEvent* event) override;

private:
    bool IsCornerAgain(const QPoint& globalPosition) const;

    std::function<void()> requestClose_;
    QElapsedTimer m_kSinceCorner; ///< invalid where no click is remembered
    QPoint m_kCorner;
};

} // namespace gw
