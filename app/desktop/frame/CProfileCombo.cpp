#include "CProfileCombo.h"

#include "QtText.h"

#include <QAbstractButton>
#include <QComboBox>
#include <QSignalBlocker>

namespace gw {

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

void CProfileCombo::SetChildren(QComboBox* field, QAbstractButton* arrow)
{
    m_kField = field;
    for (int index = 0; const std::string* text = GetItemText(index); ++index)
        field->addItem(ToQString(*text));
    ShowSelection();
    QObject::connect(field, &QComboBox::activated, field, [this](int index) { Choose(index); });
    QObject::connect(arrow, &QAbstractButton::clicked, field, &QComboBox::showPopup);
}

// The toolkit selects the first item of a list by itself; this list selects nothing.
void CProfileCombo::ShowSelection()
{
    if (!m_kField)
        return;
    const QSignalBlocker quiet(m_kField);
    m_kField->setCurrentIndex(GetCurSel());
}

void CProfileCombo::Choose(int index)
{
    SetCurSel(index);
    if (m_kNotify)
        m_kNotify(kChosen);
}

} // namespace gw
