#include "CHintPanel.h"

#include "CPushButton.h"
#include "QtText.h"

#include <QBoxLayout>
#include <QLabel>
#include <utility>

namespace gw {

namespace {

constexpr int kWidest = 420;
constexpr int kMargin = 16;

} // namespace

CHintPanel::CHintPanel(QWidget* view)
    : QFrame(view->parentWidget()), view_(view), m_pkText(new QLabel(this)), m_pkButtons(new QHBoxLayout)
{
    setObjectName(view->objectName() + QStringLiteral("Hint"));
    setProperty("kind", QStringLiteral("hint"));
    m_pkText->setObjectName(QStringLiteral("hintText"));
    m_pkText->setTextFormat(Qt::PlainText);
    m_pkText->setAlignment(Qt::AlignCenter);
    m_pkText->setWordWrap(true);
    auto* const layout = new QVBoxLayout(this);
    layout->setContentsMargins(kMargin, kMargin, kMargin, kMargin);
    layout->setSpacing(kMargin);
    layout->addWidget(m_pkText, 0, Qt::AlignHCenter);
    layout->addLayout(m_pkButtons);
    hide();
}

void CHintPanel::Show(const Hint& hint)
{
    if (hint == m_kHint)
        return;
    const bool hadFocus = window()->focusWidget() && isAncestorOf(window()->focusWidget());
    const bool sameButtons = hint.offers == m_kHint.offers;
    m_kHint = hint;
    if (hadFocus && !sameButtons && focusLost)
        focusLost();
    const QString text = ToQString(hint.text);
    m_pkText->ensurePolished(); // the style sheet may change the font
    m_pkText->setText(text);
    const int natural = m_pkText->fontMetrics().size(0, text).width() + 1;
    const int width = std::min(natural, kWidest - 2 * kMargin);
    m_pkText->setFixedSize(width, m_pkText->heightForWidth(width));
    if (!sameButtons)
        MakeButtons();
    setVisible(!hint.text.empty());
    adjustSize();
    move(view_->geometry().center() - rect().center());
    raise();
}

// The old buttons stay until the event that was clicked on them has been handled.
void CHintPanel::MakeButtons()
{
    while (QLayoutItem* item = m_pkButtons->takeAt(0))
    {
        if (QWidget* button = item->widget())
        {
            button->hide();
            button->deleteLater();
        }
        delete item;
    }
    if (m_kHint.offers.empty())
        return;
    m_pkButtons->addStretch();
    for (const Offer& offer : m_kHint.offers)
    {
        auto* const button = new CPushButton(ToQString(offer.button), this);
        button->setObjectName(QStringLiteral("offer%1").arg(static_cast<int>(offer.remedy)));
        connect(button, &QPushButton::clicked, this, [this, remedy = offer.remedy] { chosen(remedy); });
        m_pkButtons->addWidget(button);
        button->show();
    }
    m_pkButtons->addStretch();
}

} // namespace gw
