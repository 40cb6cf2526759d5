// The face's hints in empty views, and where the keyboard goes when a control is disabled.

#include "CContent.h"
#include "CGaitConvertContent.h"
#include "CHintPanel.h"
#include "QtText.h"

#include <QPainter>

namespace gw {

namespace {

constexpr int kRingWidth = 2;
constexpr QColor kRingColor(0x8f, 0xe3, 0xe3); // as of focused buttons

} // namespace

void CContent::MakeHint(QWidget* view)
{
    auto* const hint = new CHintPanel(view);
    hint->chosen = [this](ERemedy remedy) { m_pkLogic->RunRemedy(remedy); };
    hint->focusLost = [this] { FocusNext(); };
    m_kHints[ToUtf8(view->objectName())] = hint;
}

// The toolkit would pass the keyboard to the next child, which may be the button that closes the window.
void CContent::FocusView()
{
    m_kChildren.at("#cnt1")->setFocus();
}

// After an offer, Enter goes on with the conversion if it is possible.
void CContent::FocusNext()
{
    QWidget* const convert = m_kChildren.at("convert");
    if (convert->isEnabled())
        convert->setFocus();
    else
        FocusView();
}

// A view shows its scene only, so its focus ring is around it.
void CContent::paintEvent(QPaintEvent*)
{
    const QWidget* const focus = window()->focusWidget();
    if (!isActiveWindow() || !focus || focus->parentWidget() != this ||
        focus->property("kind").toString() != QLatin1String("view"))
        return;
    QPainter painter(this);
    painter.setPen(QPen(kRingColor, kRingWidth));
    painter.drawRect(QRectF(focus->geometry()).adjusted(-1, -1, 1, 1));
}

void CContent::ShowHint(std::string_view child, const Hint& hint)
{
    if (const auto panel = m_kHints.find(child); panel != m_kHints.end())
        panel->second->Show(hint);
}

} // namespace gw
