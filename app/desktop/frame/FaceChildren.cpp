// Creates the widgets of the face from the skin's kinds: buttons, displays, lists, images and bars.

#include "FaceChildren.h"

#include "CElidedLabel.h"
#include "CMapField.h"
#include "CMarkStrip.h"
#include "CPlaybar.h"
#include "CPreviewWidget.h"
#include "CTitleLabel.h"
#include "QtText.h"

#include <QComboBox>
#include <QCoreApplication>
#include <QLabel>
#include <QPainter>

namespace gw {

namespace {

class CPicture : public QWidget
{
public:
    CPicture(const QIcon& icon, QWidget* face) : QWidget(face), m_kIcon(icon)
    {
        setAttribute(Qt::WA_TransparentForMouseEvents);
    }

protected:
    void paintEvent(QPaintEvent*) override
    {
        QPainter painter(this);
        m_kIcon.paint(&painter, rect());
    }

private:
    QIcon m_kIcon;
};

QWidget* MakeLabel(const SkinChild& child, const CSkin& skin, QWidget* face)
{
    auto* const label = new CElidedLabel(face);
    label->setTextFormat(Qt::PlainText);
    label->setAlignment(Qt::AlignVCenter | (child.kind == "value" ? Qt::AlignRight : Qt::AlignLeft));
    label->ShowText(skin.Text(child.name));
    return label;
}

QWidget* MakeTitle(QWidget* face)
{
    auto* const title = new CTitleLabel(face);
    title->setTextFormat(Qt::PlainText);
    return title;
}

QWidget* MakeView(const CLeftKeys& keys, QWidget* face)
{
    if (HasOpenGL())
        return new CPreviewWidget(keys, face);
    auto* const words =
        new QLabel(QCoreApplication::translate("Face", "OpenGL is not available, so motions cannot "
                                                       "be shown.\nOpening, converting and saving "
                                                       "still work."),
                   face);
    words->setAlignment(Qt::AlignCenter);
    words->setWordWrap(true);
    return words;
}

// A view gets the keyboard when the control that had it is disabled.
QWidget* MakeFocusableView(const CLeftKeys& keys, QWidget* face)
{
    QWidget* const view = MakeView(keys, face);
    view->setFocusPolicy(Qt::StrongFocus);
    return view;
}

QWidget* MakeLine(QWidget* face)
{
    auto* const line = new QWidget(face);
    line->setAttribute(Qt::WA_StyledBackground);
    return line;
}

QWidget* MakeWidget(const SkinChild& child, const CSkin& skin, const CLeftKeys& keys, QWidget* face)
{
    if (child.kind == "picture")
        return new CPicture(skin.Icon(child.icon), face);
    if (child.kind == "caption" || child.kind == "value")
        return MakeLabel(child, skin, face);
    if (child.kind == "text")
        return MakeTitle(face);
    if (child.kind == "view")
        return MakeFocusableView(keys, face);
    if (child.kind == "marks")
        return new CMarkStrip(face);
    if (child.kind == "bar")
        return new CPlaybar(face);
    if (child.kind == "combo")
        return new CMapField(face);
    if (child.kind == "line")
        return MakeLine(face);
    return new CFaceButton(child, skin, face);
}

} // namespace

CFaceButton::CFaceButton(const SkinChild& child, const CSkin& skin, QWidget* face)
    : CPushButton(face), m_kFirst(skin.Icon(child.icon)),
      m_kSecond(child.secondIcon.empty() ? m_kFirst : skin.Icon(child.secondIcon))
{
    // A blank keeps the text away from the picture.
    const QString text = skin.Text(child.name);
    setText(text.isEmpty() || child.icon.empty() ? text : QLatin1Char(' ') + text);
    setCheckable(child.kind == "toggle");
    setIconSize(QSize(skin.IconSide(), skin.IconSide()));
    SetFace(0);
}

QWidget* MakeFaceChild(const SkinChild& child, const CSkin& skin, const CLeftKeys& keys, QWidget* face)
{
    QWidget* const widget = MakeWidget(child, skin, keys, face);
    const QString name = skin.Text(child.name, ".name");
    widget->setObjectName(ToQString(child.name));
    widget->setProperty("kind", ToQString(child.kind));
    widget->setGeometry(child.place);
    widget->setAccessibleName(name.isEmpty() ? skin.Text(child.name) : name);
    widget->setToolTip(skin.Text(child.name, ".tip"));
    return widget;
}

} // namespace gw
