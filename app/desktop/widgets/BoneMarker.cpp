#include "BoneMarker.h"

#include <QIconEngine>
#include <QPainter>
#include <iterator>

namespace gw {

namespace {

// A hollow dot is a bone that no row maps. Each of the two trees has its own color.
struct Image
{
    const char* what;
    QRgb colour;
    bool filled;
};

constexpr Image kImages[] = {
    {"unmapped",             0xff8b95a1, false},
    {"mapped in the source", 0xff3fb6a8, true },
    {"selected",             0xffffffff, false},
    {"mapped and selected",  0xffffffff, true },
    {"mapped in the target", 0xffe0a33e, true },
};

constexpr qreal kDotShare = 0.5; // as a share of the icon's size
constexpr qreal kRingShare = 0.1;

// Draws the dot at the requested size instead of scaling a picture.
class CMarkerEngine : public QIconEngine
{
public:
    CMarkerEngine(const Image& image, const Image& selected) : m_kImage(image), m_kSelected(selected) {}

    QIconEngine* clone() const override { return new CMarkerEngine(*this); }
    void paint(QPainter* painter, const QRect& rect, QIcon::Mode mode, QIcon::State) override
    {
        const Image& image = mode == QIcon::Selected ? m_kSelected : m_kImage;
        const qreal ring = kRingShare * rect.width();
        QRectF dot(0, 0, kDotShare * rect.width() - ring, kDotShare * rect.height() - ring);
        dot.moveCenter(QRectF(rect).center());
        painter->save();
        painter->setRenderHint(QPainter::Antialiasing);
        painter->setPen(QPen(QColor(image.colour), ring));
        painter->setBrush(image.filled ? QBrush(QColor(image.colour)) : QBrush());
        painter->drawEllipse(dot);
        painter->restore();
    }
    QPixmap pixmap(const QSize& size, QIcon::Mode mode, QIcon::State state) override
    {
        QPixmap picture(size);
        picture.fill(Qt::transparent);
        QPainter painter(&picture);
        paint(&painter, QRect(QPoint(), size), mode, state);
        return picture;
    }

private:
    Image m_kImage;
    Image m_kSelected;
};

bool Has(int image)
{
    return image >= 0 && static_cast<size_t>(image) < std::size(kImages);
}

} // namespace

QIcon BoneMarker(int image, int selectedImage)
{
    if (!Has(image) || !Has(selectedImage))
        return {};
    return QIcon(new CMarkerEngine(kImages[image], kImages[selectedImage]));
}

} // namespace gw
