// The program's own message box. The toolkit's box cannot scroll its details, wraps paths badly and
// interprets text that looks like markup, and all three matter for texts that contain file names.

#include "CMessageBox.h"

#include "DialogParts.h"
#include "QtText.h"

#include <QBoxLayout>
#include <QClipboard>
#include <QCoreApplication>
#include <QGuiApplication>
#include <QLabel>
#include <QPainter>
#include <QPlainTextEdit>
#include <QPushButton>
#include <QScreen>
#include <QToolButton>
#include <algorithm>
#include <span>

namespace gw {

namespace {

struct ButtonRow
{
    EAnswer answer;
    const char* name;
    const char* text;
};

constexpr ButtonRow kOKRow{EAnswer::OK, "ok", QT_TRANSLATE_NOOP("CMessageBox", "&OK")};
constexpr ButtonRow kCancelRow{EAnswer::Cancel, "cancel", QT_TRANSLATE_NOOP("CMessageBox", "&Cancel")};
constexpr ButtonRow kYesRow{EAnswer::Yes, "yes", QT_TRANSLATE_NOOP("CMessageBox", "&Yes")};
constexpr ButtonRow kNoRow{EAnswer::No, "no", QT_TRANSLATE_NOOP("CMessageBox", "&No")};

constexpr ButtonRow kOKRows[] = {kOKRow};
constexpr ButtonRow kOKCancelRows[] = {kOKRow, kCancelRow};
constexpr ButtonRow kYesNoCancelRows[] = {kYesRow, kNoRow, kCancelRow};
constexpr ButtonRow kYesNoRows[] = {kYesRow, kNoRow};

std::span<const ButtonRow> RowsOf(EButtons buttons)
{
    switch (buttons)
    {
    case EButtons::OKCancel:
        return kOKCancelRows;
    case EButtons::YesNoCancel:
        return kYesNoCancelRows;
    case EButtons::YesNo:
        return kYesNoRows;
    case EButtons::OK:
        break;
    }
    return kOKRows;
}

constexpr int kLetterSide = 36;
constexpr int kTextWidth = 440;
constexpr int kLeastWidth = 320;
constexpr double kMostOfScreen = 0.6; // maximum share of the screen's height for the box

QString BoxText(const char* text)
{
    return QCoreApplication::translate("CMessageBox", text);
}

// A ring around a letter, in the text color.
class CMessageIcon : public QWidget
{
public:
    explicit CMessageIcon(QChar letter) : m_kLetter(letter) { setFixedSize(kLetterSide, kLetterSide); }

protected:
    void paintEvent(QPaintEvent*) override
    {
        QPainter painter(this);
        painter.setRenderHint(QPainter::Antialiasing);
        painter.setPen(QPen(palette().windowText(), 2));
        painter.drawEllipse(QRectF(rect()).adjusted(2, 2, -2, -2));
        QFont letters = font();
        letters.setPixelSize(kLetterSide / 2);
        letters.setBold(true);
        painter.setFont(letters);
        painter.drawText(rect(), Qt::AlignCenter, m_kLetter);
    }

private:
    QChar m_kLetter;
};

QWidget* MakeIcon(bool asks)
{
    auto* icon = new CMessageIcon(QLatin1Char(asks ? '?' : 'i'));
    return Named(icon, "icon", asks ? BoxText("Question") : BoxText("Information"));
}

// A path is one long word, which a label would not wrap, so invisible break opportunities are inserted.
QString Breakable(const QString& text)
{
    constexpr int kLongWord = 40;
    constexpr QChar kBreak(0x200b);
    QString result;
    int run = 0;
    for (const QChar letter : text)
    {
        result += letter;
        run = letter.isSpace() ? 0 : run + 1;
        const bool isSeparator = letter == QLatin1Char('/') || letter == QLatin1Char('\\');
        if (run == 0 || !(isSeparator || run >= kLongWord) || letter.isHighSurrogate())
            continue;
        result += kBreak;
        run = 0;
    }
    return result;
}

int WrappedHeight(const QWidget& widget, int width, const QString& text)
{
    const QRect room(0, 0, width, QWIDGETSIZE_MAX);
    return widget.fontMetrics().boundingRect(room, Qt::TextWordWrap, Breakable(text)).height();
}

} // namespace

CMessageBox::CMessageBox(QWidget* owner, const QString& caption, const QString& text, EButtons buttons,
                         const BoxExtras& extras)
    : QDialog(owner), m_eEscape(RowsOf(buttons).back().answer)
{
    Named(this, "messageBox", caption);
    setWindowTitle(caption);
    auto* top = new QHBoxLayout;
    top->setSpacing(kDialogMargin);
    top->addWidget(MakeIcon(buttons != EButtons::OK), 0, Qt::AlignTop);
    top->addWidget(MakeText(text, "text"), 1, Qt::AlignLeft | Qt::AlignVCenter);
    auto* layout = new QVBoxLayout(this);
    layout->setContentsMargins(kDialogMargin, kDialogMargin, kDialogMargin, kDialogMargin);
    layout->setSpacing(kDialogMargin);
    layout->setSizeConstraint(QLayout::SetFixedSize); // resizes with the details
    layout->addLayout(top);
    layout->addStrut(kLeastWidth);
    if (!extras.summary.empty())
        layout->addWidget(MakeText(ToQString(extras.summary), "summary"));
    if (!extras.details.empty())
        layout->addWidget(MakeDetails(ToQString(extras.details)));
    layout->addLayout(MakeButtons(buttons, extras));
    if (m_pkFold && extras.shown == EDetails::Unfolded)
        m_pkFold->setChecked(true);
}

QWidget* CMessageBox::MakeText(const QString& text, const char* name)
{
    auto* label = Named(new QLabel(this), name, text);
    label->setTextFormat(Qt::PlainText);
    label->setText(Breakable(text));
    label->setWordWrap(true);
    label->ensurePolished(); // the style sheet may change the font
    const QSize screenSize = screen()->availableSize();
    const int natural = label->fontMetrics().size(0, label->text()).width() + 1;
    int width = std::min(natural, kTextWidth);
    if (label->heightForWidth(width) > screenSize.height() / 3)
        width = std::min(natural, screenSize.width() * 4 / 5);
    label->setFixedSize(width, label->heightForWidth(width));
    return label;
}

QWidget* CMessageBox::MakeDetails(const QString& details)
{
    m_pkDetails = Named(new QPlainTextEdit(details, this), "detailsText", BoxText("Details"));
    m_pkDetails->ensurePolished(); // the style sheet may change the font
    m_pkDetails->setReadOnly(true);
    m_pkDetails->setTabChangesFocus(true);
    m_pkDetails->setWordWrapMode(QTextOption::WrapAtWordBoundaryOrAnywhere);
    m_pkDetails->setMinimumWidth(kLetterSide + kDialogMargin + kTextWidth);
    m_pkDetails->hide();
    return m_pkDetails;
}

QLayout* CMessageBox::MakeButtons(EButtons buttons, const BoxExtras& extras)
{
    auto* layout = new QHBoxLayout;
    layout->addStretch();
    layout->setSpacing(kDialogSpacing);
    for (const ButtonRow& row : RowsOf(buttons))
    {
        auto* button = Named(new QPushButton(BoxText(row.text), this), row.name,
                             BoxText(row.text).remove(QLatin1Char('&')));
        button->setMinimumWidth(kButtonWidth);
        button->setDefault(layout->count() == 1);
        connect(button, &QPushButton::clicked, this, [this, &row] { done(static_cast<int>(row.answer)); });
        layout->addWidget(button);
    }
    AddOffers(*layout, extras.offers);
    if (!extras.details.empty())
        AddDetailsButtons(*layout);
    return layout;
}

// To the left of the answers.
void CMessageBox::AddOffers(QBoxLayout& layout, const std::vector<std::string>& offers)
{
    for (int index = 0; index < static_cast<int>(offers.size()); ++index)
    {
        const QString text = ToQString(offers[static_cast<size_t>(index)]);
        auto* button = Named(new QPushButton(this), "offer", text);
        button->setText(QString(text).replace(QLatin1Char('&'), QStringLiteral("&&")));
        button->setAutoDefault(false);
        connect(button, &QPushButton::clicked, this, [this, index] {
            m_iOffer = index;
            reject();
        });
        layout.insertWidget(1 + index, button);
    }
}

// To the left of the other buttons, but after them in Tab order.
void CMessageBox::AddDetailsButtons(QBoxLayout& layout)
{
    m_pkFold = Named(new QToolButton(this), "details", BoxText("Details"));
    m_pkFold->setText(BoxText("&Details"));
    m_pkFold->setToolButtonStyle(Qt::ToolButtonTextBesideIcon);
    m_pkFold->setArrowType(Qt::RightArrow);
    m_pkFold->setCheckable(true);
    m_pkFold->setFocusPolicy(Qt::StrongFocus);
    auto* copy = Named(new QPushButton(BoxText("Co&py"), this), "copy", BoxText("Copy the details"));
    copy->setAutoDefault(false);
    copy->hide();
    connect(m_pkFold, &QToolButton::toggled, this, [this, copy](bool visible) {
        m_pkFold->setArrowType(visible ? Qt::DownArrow : Qt::RightArrow);
        copy->setVisible(visible);
        ShowDetails(visible);
    });
    connect(copy, &QPushButton::clicked, this,
            [this] { QGuiApplication::clipboard()->setText(m_pkDetails->toPlainText()); });
    layout.insertWidget(0, m_pkFold);
    layout.insertWidget(1, copy);
}

void CMessageBox::ShowDetails(bool visible)
{
    if (visible)
    {
        const int margins = 2 * kDialogMargin;
        const int least = 4 * m_pkDetails->fontMetrics().lineSpacing();
        // The size hint instead of the height, which is unknown before the box is shown.
        const int most = static_cast<int>(kMostOfScreen * screen()->availableSize().height()) -
                         sizeHint().height() - margins;
        const int wanted =
            WrappedHeight(*m_pkDetails, m_pkDetails->minimumWidth() - margins, m_pkDetails->toPlainText()) +
            margins;
        m_pkDetails->setFixedHeight(std::clamp(wanted, least, std::max(least, most)));
    }
    m_pkDetails->setVisible(visible);
}

EAnswer CMessageBox::Run()
{
    return static_cast<EAnswer>(exec());
}

void CMessageBox::reject()
{
    done(static_cast<int>(m_eEscape));
}

EAnswer RunMessageBox(QWidget* owner, const std::string& caption, const std::string& text, EButtons buttons,
                      const BoxExtras& extras, int* offer)
{
    CMessageBox box(owner, ToQString(caption), ToQString(text), buttons, extras);
    const EAnswer answer = box.Run();
    if (offer)
        *offer = box.ChosenOffer();
    return answer;
}

} // namespace gw
