#pragma once

#include "CFailureRecord.h"
#include "CObject.h"

#include <span>
#include <unordered_map>
#include <vector>

namespace gw {

/// Limits on the visits of a walk from the roots, which visits a shared object once per path to it: a limit
/// per object, and one in total, at which an update takes seconds.
inline constexpr double kVisitsPerObject = 1e6;
inline constexpr double kVisitsLimit = 5e7;

/// Walks a graph along its counted references, without recursion, and finds what a recursive walk would run
/// into: cycles, the nesting depth, and the number of visits.
class CGraphCheck
{
public:
    /// Returns None, Cycle, TooDeep or TooLarge. `objects` must include every object that the roots reach,
    /// and may include others.
    EFailure Check(std::span<CObject* const> objects, std::span<const Ref<CObject>> roots);

private:
    struct Entry
    {
        size_t depth = 1;
        double visits = 1.0;
        bool finished = false;
    };
    struct Step
    {
        CObject* object;
        std::vector<CObject*> held;
        size_t next = 0;
    };

    EFailure Walk(CObject& start);
    bool Finish(const Step& step);

    std::unordered_map<const CObject*, Entry> m_kEntries;
};

} // namespace gw
