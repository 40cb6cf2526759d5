#include "JointNames.h"

#include "CNode.h"
#include "NamePrefix.h"

#include <string>
#include <string_view>

namespace gw {

std::vector<JointName> ReadJointNames(std::span<CNode* const> nodes)
{
    std::vector<std::string_view> names;
    names.reserve(nodes.size());
    for (const CNode* node : nodes)
        names.push_back(WithoutNamespace(node->NameView()));
    const std::string prefix = FindNamePrefix(names);
    std::vector<JointName> read;
    read.reserve(nodes.size());
    for (const std::string_view name : names)
        read.push_back(ReadJointName(WithoutPrefix(name, prefix)));
    return read;
}

} // namespace gw
