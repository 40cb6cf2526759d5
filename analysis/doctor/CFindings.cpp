#include "CFindings.h"

#include <algorithm>
#include <utility>

namespace gw {

namespace {

constexpr std::ptrdiff_t kKept = 5; // places per fault

bool IsFault(const Finding& finding)
{
    return finding.severity != ESeverity::Note;
}

Finding FindingOf(EFault fault, size_t line, std::string name, bool mendable)
{
    return {fault, line, std::move(name), RowOf(fault).severity, mendable, EFailure::None, 0};
}

} // namespace

void CFindings::Add(EFault fault, size_t line, std::string name)
{
    Keep(FindingOf(fault, line, std::move(name), RowOf(fault).mends));
}

void CFindings::AddUnmended(EFault fault, size_t line, std::string name)
{
    Keep(FindingOf(fault, line, std::move(name), false));
}

void CFindings::AddReader(const CFailure& failure, ESeverity severity)
{
    Keep({EFault::Reader, failure.where, failure.name, severity, false, failure.reason, 0});
}

void CFindings::Keep(const Finding& finding)
{
    const auto isAlike = [&](const Finding& kept) {
        return kept.fault == finding.fault && kept.mendable == finding.mendable &&
               kept.reason == finding.reason;
    };
    if (std::ranges::count_if(m_kFindings, isAlike) < kKept)
        m_kFindings.push_back(finding);
    else
        ++std::find_if(m_kFindings.rbegin(), m_kFindings.rend(), isAlike)->more;
}

std::vector<Finding> CFindings::Sorted() const
{
    std::vector<Finding> sorted = m_kFindings;
    std::ranges::stable_sort(sorted, {}, &Finding::where);
    return sorted;
}

bool CFindings::Has(EFault fault) const
{
    return std::ranges::find(m_kFindings, fault, &Finding::fault) != m_kFindings.end();
}

bool CFindings::HasErrors() const
{
    return std::ranges::find(m_kFindings, ESeverity::Error, &Finding::severity) != m_kFindings.end();
}

bool CFindings::HasFaults() const
{
    return std::ranges::any_of(m_kFindings, IsFault);
}

bool CFindings::MendsAny() const
{
    return std::ranges::any_of(m_kFindings, [](const Finding& f) { return IsFault(f) && f.mendable; });
}

} // namespace gw
