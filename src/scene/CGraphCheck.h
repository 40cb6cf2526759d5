#pragma once

#include "CFailure.h"
#include "CObject.h"

#include <span>
#include <unordered_map>
#include <vector>

namespace gw {

/// Places that a walk from the roots may visit, shared objects once per place: so many for each object, and
/// so many in all, which an update takes seconds for.
inline constexpr double kVisitsPerObject = 1e6;
inline constexpr double kVisitsLimit = 5e7;

/// Walks a graph by its counted references, without recursion, and tells what recursion would meet: rings,
/// the deepest nesting, and the number of places to visit.
class CGraphCheck
{
public:
    /// None, Cycle, TooDeep or TooLarge. The objects are all those that the roots reach, and may be more.
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
