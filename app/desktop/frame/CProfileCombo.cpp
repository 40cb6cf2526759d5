#include "CProfileCombo.h"

#include "CMapField.h"
#include "QtText.h"

#include <QAbstractButton>
#include <QAbstractItemView>
#include <QComboBox>
#include <QSignalBlocker>

namespace gw {

namespace {

constexpr double kSizesPerPoint = 10.0;

// A size in the skin's style sheet takes precedence.
void ChangeFont(QWidget& widget, const QString& family, int size)
{
    QFont font = widget.font();
    if (!family.isEmpty())
        font.setFamily(family);
    if (size > 0)
        font.setPointSizeF(size / kSizesPerPoint);
    widget.setFont(font);
}

} // namespace

void CProfileCombo::AddItem(const std::string& text, int userData)
{
    CProfileList::AddItem(text, userData);
    if (m_kField)
        m_kField->addItem(ToQString(text));
    ShowSelection();
}

void CProfileCombo::DeleteItem(int index)
{
    CProfileList::DeleteItem(index);
    if (!m_kField)
        return;
    const QSignalBlocker quiet(m_kField);
    if (index == -1)
        m_kField->clear();
    else
        m_kField->removeItem(index);
    ShowSelection();
}

void CProfileCombo::SetCurSel(int index)
{
    CProfileList::SetCurSel(index);
    ShowSelection();
}

void CProfileCombo::SetItemWords(int index, const std::string& words, const std::string& tip)
{
    CProfileList::SetItemWords(index, words, tip);
    if (!m_kField)
        return;
    m_kField->setItemData(index, ToQString(words), CMapField::kWordsRole);
    m_kField->setItemData(index, ToQString(tip), Qt::ToolTipRole);
    if (index == GetCurSel())
        ShowSelection();
}

void CProfileCombo::SetFont(const std::string& family, int fieldSize, int listSize)
{
    if (!m_kField)
        return;
    ChangeFont(*m_kField, ToQString(family), fieldSize);
    ChangeFont(*m_kField->view(), ToQString(family), listSize);
}

void CProfileCombo::SetChildren(QComboBox* field, QAbstractButton* arrow, int fontSize)
{
    m_kField = field;
    m_kTip = field->toolTip();
    ChangeFont(*field, {}, fontSize);
    for (int index = 0; const std::string* text = GetItemText(index); ++index)
        field->addItem(ToQString(*text));
    ShowSelection();
    QObject::connect(field, &QComboBox::activated, field, [this](int index) { Choose(index); });
    QObject::connect(arrow, &QAbstractButton::clicked, field, &QComboBox::showPopup);
}

// The toolkit selects a list's first item by itself; undo that.
void CProfileCombo::ShowSelection()
{
    if (!m_kField)
        return;
    const QSignalBlocker quiet(m_kField);
    m_kField->setCurrentIndex(GetCurSel());
    const QString tip = ToQString(ItemTip(GetCurSel()));
    m_kField->setToolTip(tip.isEmpty() ? m_kTip : tip);
}

void CProfileCombo::Choose(int index)
{
    SetCurSel(index);
    if (notify_)
        notify_(kChosen);
}

} // namespace gw
