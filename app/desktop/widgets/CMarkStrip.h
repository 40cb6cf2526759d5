#pragma once

#include "MotionMarks.h"

#include <QWidget>
#include <functional>

namespace gw {

/// The strip under the bar: two thin lines per foot show where it is planted, first in the source, then in
/// the result; ticks show the frames to check. Positions are those of the bar above.
class CMarkStrip : public QWidget
{
public:
    explicit CMarkStrip(QWidget* parent);

    /// Shows other marks; none if their frame count is 0.
    void ShowMarks(const MotionMarks& marks);
    /// Called with the clicked frame: a tick's if it is near.
    std::function<void(int frame)> goTo = [](int) {};

protected:
    bool event(QEvent* event) override;
    void paintEvent(QPaintEvent* event) override;
    void mousePressEvent(QMouseEvent* event) override;

private:
    double PlaceOf(double frame) const;
    double FrameAt(double x) const;
    const WorstFrame* WorstAt(double x) const;
    QString TipAt(const QPoint& at) const;
    void PaintContacts(QPainter& painter, const std::vector<Contact>& contacts, int line) const;

    MotionMarks m_kMarks;
};

} // namespace gw
