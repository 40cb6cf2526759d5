#pragma once

#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

namespace gw {

class CNode;

/// The bones of a skeleton as a tree of names, each with a marker that shows whether a row maps it. Names are
/// distinct, ignoring case. Items are numbered in insertion order, so parents come before their children.
class CBoneTree
{
public:
    /// No item; as a parent, the root of the tree.
    static constexpr int kNone = -1;
    /// Images of an unmapped item, and of a selected mapped one, in every tree.
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

    /// `mappedImage` is the image of a mapped item that is not selected; it differs between the two trees.
    explicit CBoneTree(int mappedImage) : m_iMappedImage(mappedImage) {}

    /// Replaces all items by the named nodes of a skeleton; null has none. Nodes with an earlier node's name
    /// are left out. Nothing is mapped or selected afterwards.
    void Rebuild(CNode* root);
    /// Returns the item with a name, ignoring case, or kNone.
    int Find(std::string_view name) const;
    /// Ignored for an invalid item.
    void Mark(int item, bool mapped);
    bool IsMapped(int item) const { return Has(item) && m_kItems[Index(item)].m_bMapped; }
    /// Selects an item, or none with kNone.
    void Select(int item) { m_iSelected = Has(item) ? item : kNone; }
    int Selected() const { return m_iSelected; }
    /// Returns the text of the selected item; empty if there is none.
    const std::string& SelectedText() const { return Text(m_iSelected); }
    const std::string& Text(int item) const;

    int Image(int item) const { return IsMapped(item) ? m_iMappedImage : kUnmappedImage; }
    int SelectedImage(int item) const
    {
        return IsMapped(item) ? kSelectedMappedImage : kSelectedUnmappedImage;
    }

    const std::vector<Item>& Items() const { return m_kItems; }
    /// Returns the items directly below the root.
    const std::vector<int>& RootItems() const { return m_kRootItems; }

private:
    static size_t Index(int item) { return static_cast<size_t>(item); }
    bool Has(int item) const { return item >= 0 && Index(item) < m_kItems.size(); }
    void Add(std::string_view name, int parent);

    std::vector<Item> m_kItems;
    std::vector<int> m_kRootItems;
    std::unordered_map<std::string, int> m_kByName; // in lowercase
    int m_iSelected = kNone;
    int m_iMappedImage;
};

} // namespace gw
