#include "CCntComboExControl.h"

namespace gw {

bool CProfileList::Has(int index) const
{
    return index >= 0 && static_cast<size_t>(index) < m_kItems.size();
}

void CProfileList::AddItem(const std::string& text, int userData)
{
    m_kItems.push_back({text, userData});
}

void CProfileList::DeleteItem(int index)
{
    if (index == -1)
    {
        m_kItems.clear();
        m_iSelected = -1;
    }
    if (!Has(index))
        return;
    m_kItems.erase(m_kItems.begin() + index);
    // Selects the entry that moved into the place of a deleted selected one, or the last one.
    if (m_iSelected > index || !Has(m_iSelected))
        --m_iSelected;
}

void CProfileList::SetCurSel(int index)
{
    m_iSelected = Has(index) ? index : -1;
}

const std::string* CProfileList::GetItemText(int index) const
{
    return Has(index) ? &m_kItems[Index(index)].m_kText : nullptr;
}

int CProfileList::GetItemUserData(int index) const
{
    return Has(index) ? m_kItems[Index(index)].m_iUserData : 0;
}

void CProfileList::SetItemWords(int index, const std::string& words, const std::string& tip)
{
    if (!Has(index))
        return;
    m_kItems[Index(index)].m_kWords = words;
    m_kItems[Index(index)].m_kTip = tip;
}

} // namespace gw
