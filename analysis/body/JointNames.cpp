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
    std::vector<JointName> read;
    read.reserve(nodes.size());
    for (const std::string_view name : names)
        read.push_back(ReadJointName(name));
    const std::string prefix = FindNamePrefix(names, read);
    for (size_t i = 0; !prefix.empty() && i < names.size(); ++i)
        read[i] = ReadJointName(WithoutPrefix(names[i], prefix));
    return read;
}

} // namespace gw
