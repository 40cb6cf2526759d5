#include "TKCHFile.h"

#include <algorithm>
#include <cstdint>
#include <limits>
#include <map>

namespace gw {

namespace {

constexpr const char* kRootName = "Global";

// The segments form a tree with at most kSegmentLimit levels, so recursion ends.
TKCHSegment* FindBelow(const TKCHSegment& parent, std::string_view name)
{
    for (TKCHSegment* child : parent.children)
    {
        if (child->name == name)
            return child;
        if (TKCHSegment* found = FindBelow(*child, name))
            return found;
    }
    return nullptr;
}

} // namespace

void TKCHFile::CountFrames()
{
    const int64_t count = int64_t{endFrame} - beginFrame + 1;
    constexpr int64_t kMost = std::numeric_limits<int>::max();
    frameCount = static_cast<int>(std::clamp<int64_t>(count, 0, kMost));
}

void TKCHFile::MakeRoot()
{
    segments.clear();
    root = std::make_unique<TKCHSegment>();
    root->name = kRootName;
}

void TKCHFile::AddSegment(std::string_view name, std::string_view parentName)
{
    auto& segment = segments.emplace_back(std::make_unique<TKCHSegment>());
    segment->name = name;
    segment->parentName = parentName;
    const auto length = std::ranges::find(lengths, name, &decltype(lengths)::value_type::first);
    segment->length = length == lengths.end() ? 0.0f : length->second;
}

void TKCHFile::LinkSegments(CFailureRecord& record, size_t line)
{
    std::map<std::string_view, TKCHSegment*> segmentOfName{
        {root->name, root.get()}
    };
    for (const auto& segment : segments)
        segmentOfName.emplace(segment->name, segment.get());
    for (const auto& segment : segments)
    {
        const auto parent = segmentOfName.find(segment->parentName);
        if (parent != segmentOfName.end())
            parent->second->children.push_back(segment.get());
        else
            record.Warn(EFailure::UnknownSegment, line, segment->parentName);
    }
}

TKCHSegment* TKCHFile::FindSegment(std::string_view name) const
{
    return root ? FindBelow(*root, name) : nullptr;
}

} // namespace gw
