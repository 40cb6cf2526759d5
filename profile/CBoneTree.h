#pragma once

#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

namespace gw {

class CNode;

/// The bones of a skeleton as a tree of names, each with a marker that says whether a row maps it. Names are
/// distinct without regard to case. Items are indices in the order of their adding, so a parent comes before
/// its children.
class CBoneTree
{
public:
    /// No item; as a parent, the root of the tree.
    static constexpr int kNone = -1;
    /// Images of an item that is not mapped, and of a mapped one that is selected, in every tree.
    static constexpr int kUnmappedImage = 0;
    static constexpr int kSelectedUnmappedImage = 2;
    static constexpr int kSelectedMappedImage = 3;

    struct Item
    {
        std::string m_kText;
        int m_iParent = kNone;
        std::vector<int> m_kChildren;
        bool m_bMapped = false;
    };

    /// The argument is the image of a mapped item that is not selected; it tells the two trees apart.
    explicit CBoneTree(int mappedImage) : m_iMappedImage(mappedImage) {}

    /// Lets go of all items and takes the named nodes of a skeleton, none for null. A node with the name of
    /// an earlier one is left out; nothing is mapped or selected then.
    void Rebuild(CNode* root);
    /// The item with a name without regard to case, or kNone.
    int Find(std::string_view name) const;
    /// Nothing for an item that is none.
    void Mark(int item, bool mapped);
    bool IsMapped(int item) const { return Has(item) && m_kItems[Index(item)].m_bMapped; }
    /// Selects an item, or with kNone nothing.
    void Select(int item) { m_iSelected = Has(item) ? item : kNone; }
    int Selected() const { return m_iSelected; }
    /// The text of the selected item; empty when there is none.
    const std::string& SelectedText() const { return Text(m_iSelected); }
    const std::string& Text(int item) const;

    int Image(int item) const { return IsMapped(item) ? m_iMappedImage : kUnmappedImage; }
    int SelectedImage(int item) const
    {
        return IsMapped(item) ? kSelectedMappedImage : kSelectedUnmappedImage;
    }

    const std::vector<Item>& Items() const { return m_kItems; }
    /// The items directly below the root.
    const std::vector<int>& RootItems() const { return m_kRootItems; }

private:
    static size_t Index(int item) { return static_cast<size_t>(item); }
    bool Has(int item) const { return item >= 0 && Index(item) < m_kItems.size(); }
    void Add(std::string_view name, int parent);

    std::vector<Item> m_kItems;
    std::vector<int> m_kRootItems;
    std::unordered_map<std::string, int> m_kByName; // in lower case
    int m_iSelected = kNone;
    int m_iMappedImage;
};

} // namespace gw
