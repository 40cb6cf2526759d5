#pragma once

#include <string>
#include <vector>

namespace gw {

/// The list of profiles: texts with a number each, at most one of them selected.
class CCntComboExControl
{
public:
    virtual ~CCntComboExControl() = default;

    virtual void AddItem(const std::string& text, int userData) = 0;
    /// Deletes one entry, or all with -1.
    virtual void DeleteItem(int index) = 0;
    /// Returns the selected index, or -1.
    virtual int GetCurSel() const = 0;
    /// Selects an entry without the notification of a user's choice; -1 selects none.
    virtual void SetCurSel(int index) = 0;
    /// Returns the text of an entry, valid until the list changes; null for an index out of range.
    virtual const std::string* GetItemText(int index) const = 0;
    virtual int GetItemUserData(int index) const = 0;
    /// Shows a few words beside an entry, and a tool tip with its full text.
    virtual void SetItemWords(int, const std::string&, const std::string&) {}
    /// Sets the font of the field and of the open list: a family, and each size in tenths of a point. A size
    /// of 0 or below keeps the current size. Does nothing if no text is shown.
    virtual void SetFont(const std::string&, int, int) {}
};

/// The list alone, without a display. A window can show it after every change.
class CProfileList : public CCntComboExControl
{
public:
    void AddItem(const std::string& text, int userData) override;
    void DeleteItem(int index) override;
    int GetCurSel() const override { return m_iSelected; }
    void SetCurSel(int index) override;
    const std::string* GetItemText(int index) const override;
    int GetItemUserData(int index) const override;
    void SetItemWords(int index, const std::string& words, const std::string& tip) override;
    /// Return an entry's words and tool tip; empty for an index out of range.
    std::string ItemWords(int index) const { return Has(index) ? m_kItems[Index(index)].m_kWords : ""; }
    std::string ItemTip(int index) const { return Has(index) ? m_kItems[Index(index)].m_kTip : ""; }

private:
    struct Item
    {
        std::string m_kText;
        int m_iUserData;
        std::string m_kWords = {};
        std::string m_kTip = {};
    };

    static size_t Index(int index) { return static_cast<size_t>(index); }

    bool Has(int index) const;

    std::vector<Item> m_kItems;
    int m_iSelected = -1;
};

} // namespace gw
