#include "FilterBones.h"

#include "CBoneTree.h"
#include "Text.h"

#include <algorithm>

namespace gw {

std::vector<int> FilterBones(const CBoneTree& tree, std::string_view text)
{
    const std::string part = LowerCase(text);
    std::vector<int> bones;
    for (int item = 0; item < static_cast<int>(tree.Items().size()); ++item)
    {
        if (LowerCase(tree.Text(item)).find(part) != std::string::npos)
            bones.push_back(item);
    }
    const auto rank = [&](int item) { return item == tree.Find(text) ? 0 : tree.IsMapped(item) ? 2 : 1; };
    std::ranges::stable_sort(bones, {}, rank);
    return bones;
}

std::string BonePath(const CBoneTree& tree, int item)
{
    std::string path;
    const auto& items = tree.Items();
    const auto parentOf = [&](int child) { return items[static_cast<size_t>(child)].m_iParent; };
    for (int bone = parentOf(item); bone != CBoneTree::kNone; bone = parentOf(bone))
        path.insert(0, path.empty() ? "" : " / ").insert(0, tree.Text(bone));
    return path;
}

} // namespace gw
