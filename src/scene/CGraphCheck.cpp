// Why the walk needs no recursion and still ends: each object is entered once and its held objects are pushed
// on an explicit stack. An object that is met again while it is still on the path closes a cycle; one that is
// already finished brings its known depth and visit count along. Every link is therefore followed once,
// however many paths lead to it.

#include "CGraphCheck.h"

#include <algorithm>

namespace gw {

EFailure CGraphCheck::Check(std::span<CObject* const> objects, std::span<const Ref<CObject>> roots)
{
    for (CObject* object : objects)
    {
        const EFailure reason = Walk(*object);
        if (reason != EFailure::None)
            return reason;
    }
    double visits = 0.0;
    for (const auto& root : roots)
        visits += m_kEntries[root.Get()].visits;
    const double limit = std::min(kVisitsPerObject * static_cast<double>(objects.size()), kVisitsLimit);
    return visits > limit ? EFailure::TooLarge : EFailure::None;
}

EFailure CGraphCheck::Walk(CObject& start)
{
    if (!m_kEntries.try_emplace(&start).second)
        return EFailure::None;
    std::vector<Step> path;
    path.push_back({&start, start.HeldObjects()});
    while (!path.empty())
    {
        Step& step = path.back();
        if (step.next < step.held.size())
        {
            CObject* held = step.held[step.next++];
            const auto [entry, fresh] = m_kEntries.try_emplace(held);
            if (fresh)
                path.push_back({held, held->HeldObjects()});
            else if (!entry->second.finished)
                return EFailure::Cycle;
            continue;
        }
        if (!Finish(step))
            return EFailure::TooDeep;
        path.pop_back();
    }
    return EFailure::None;
}

// All objects below are finished. Without cycles, this also holds for those met earlier.
bool CGraphCheck::Finish(const Step& step)
{
    Entry& entry = m_kEntries[step.object];
    for (const CObject* held : step.held)
    {
        const Entry& below = m_kEntries[held];
        entry.depth = std::max(entry.depth, below.depth + 1);
        entry.visits += below.visits;
    }
    entry.finished = true;
    return entry.depth <= kNestingLimit;
}

} // namespace gw
