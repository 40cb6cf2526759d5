// Draws the small buttons' pictures as polygons, so that they are sharp at any scale and follow the text
// color.

#include "CIconButton.h"

#include <QPaintEvent>
#include <QPainter>
#include <QPainterPath>
#include <QStyleOptionButton>

namespace gw {

namespace {

constexpr QSize kButtonSize(36, 26);
constexpr qreal kIconSide = 16; // size of the pictures' coordinate square

// A picture has up to three areas of four corners; a triangle has two equal corners.
struct Area
{
    qreal m_afCorners[8];
};

constexpr Area kNothing{};
constexpr Area kToLeft{
    {3, 8, 12, 3, 12, 13, 12, 13}
};
constexpr Area kToRight{
    {4, 3, 13, 8, 13, 8, 4, 13}
};
constexpr Area kBarLeft{
    {2, 3, 4, 3, 4, 13, 2, 13}
};
constexpr Area kBarRight{
    {13, 3, 15, 3, 15, 13, 13, 13}
};
constexpr Area kLeftOfBar{
    {4, 8, 13, 3, 13, 13, 13, 13}
};
constexpr Area kRightOfBar{
    {5, 3, 14, 8, 14, 8, 5, 13}
};
constexpr Area kSquare{
    {4, 4, 12, 4, 12, 12, 4, 12}
};
constexpr Area kLineTop{
    {2, 3, 14, 3, 14, 5, 2, 5}
};
constexpr Area kLineMiddle{
    {2, 7, 14, 7, 14, 9, 2, 9}
};
constexpr Area kLineBottom{
    {2, 11, 14, 11, 14, 13, 2, 13}
};

// Indexed by EButtonIcon.
constexpr Area kPictures[][3] = {
    {kBarLeft, kLeftOfBar,  kNothing   }, // first frame
    {kToLeft,  kBarRight,   kNothing   }, // previous frame
    {kSquare,  kNothing,    kNothing   }, // stop
    {kToRight, kNothing,    kNothing   }, // play
    {kBarLeft, kRightOfBar, kNothing   }, // next frame
    {kLineTop, kLineMiddle, kLineBottom}, // menu
};

QPainterPath PathOf(EButtonIcon icon)
{
    QPainterPath path;
    for (const Area& area : kPictures[static_cast<size_t>(icon)])
    {
        const auto& at = area.m_afCorners;
        path.addPolygon(QPolygonF({
            {at[0], at[1]},
            {at[2], at[3]},
            {at[4], at[5]},
            {at[6], at[7]}
        }));
        path.closeSubpath();
    }
    return path;
}

} // namespace

CIconButton::CIconButton(EButtonIcon icon, const QString& name, QWidget* parent)
    : QPushButton(parent), m_eIcon(icon)
{
    setAccessibleName(name);
    setToolTip(name);
    setAutoDefault(false);
    setProperty("kind", QStringLiteral("button")); // no padding for text
}

QSize CIconButton::sizeHint() const
{
    return kButtonSize;
}

void CIconButton::paintEvent(QPaintEvent* event)
{
    QPushButton::paintEvent(event);
    QPainter painter(this);
    painter.setRenderHint(QPainter::Antialiasing);
    // Aligned to whole pixels, so that bars have sharp edges.
    painter.translate(QPoint(qRound((width() - kIconSide) / 2), qRound((height() - kIconSide) / 2)));
    painter.fillPath(PathOf(m_eIcon), palette().color(QPalette::ButtonText));
}

} // namespace gw
