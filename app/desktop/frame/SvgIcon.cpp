#include "SvgIcon.h"

#include <QIconEngine>
#include <QPainter>
#include <QPixmap>
#include <QSvgRenderer>
#include <memory>

namespace gw {

namespace {

constexpr qreal kDisabledOpacity = 0.35;

class CSvgEngine : public QIconEngine
{
public:
    explicit CSvgEngine(const QString& path) : m_spkPicture(std::make_shared<QSvgRenderer>(path)) {}

    void paint(QPainter* painter, const QRect& place, QIcon::Mode mode, QIcon::State) override
    {
        painter->save();
        painter->setOpacity(mode == QIcon::Disabled ? kDisabledOpacity : 1.0);
        m_spkPicture->render(painter, place);
        painter->restore();
    }
    QPixmap pixmap(const QSize& size, QIcon::Mode mode, QIcon::State state) override
    {
        QPixmap picture(size);
        picture.fill(Qt::transparent);
        QPainter painter(&picture);
        paint(&painter, QRect(QPoint(0, 0), size), mode, state);
        return picture;
    }
    QIconEngine* clone() const override { return new CSvgEngine(*this); }
    QString key() const override { return QStringLiteral("gaitwright-svg"); }

private:
    std::shared_ptr<QSvgRenderer> m_spkPicture;
};

} // namespace

QIcon SvgIcon(const QString& path)
{
    return QIcon(new CSvgEngine(path));
}

} // namespace gw
