#include "CFindings.h"

#include <algorithm>
#include <utility>

namespace gw {

namespace {

constexpr std::ptrdiff_t kKept = 5; // places per fault

// A fault in neither list is an error that a mended copy does not have.
constexpr EFailure kUnmended[] = {
    EFailure::LfsPointer,     EFailure::NotText,       EFailure::SameName,    EFailure::ChannelCount,
    EFailure::IgnoredChannel, EFailure::SecondRoot,    EFailure::RateForTime, EFailure::NoFrames,
    EFailure::LongRow,        EFailure::NotNumber,     EFailure::StillRoot,   EFailure::SidesSwapped,
    EFailure::WrongRate,      EFailure::MixedChannels,
};
constexpr EFailure kWarnings[] = {
    EFailure::ByteOrderMark,    EFailure::BlankInName, EFailure::SameName,  EFailure::SecondRoot,
    EFailure::RateForTime,      EFailure::SurplusRows, EFailure::NoFrames,  EFailure::DoubledBone,
    EFailure::DoubledHipOffset, EFailure::Spike,       EFailure::StillRoot, EFailure::SidesSwapped,
    EFailure::WrongRate,
};

bool IsFault(const Finding& finding)
{
    return finding.severity != ESeverity::Note;
}

bool IsMended(EFailure reason)
{
    return std::ranges::find(kUnmended, reason) == std::end(kUnmended);
}

ESeverity SeverityOf(EFailure reason)
{
    if (reason == EFailure::MixedChannels)
        return ESeverity::Note;
    const bool warns = std::ranges::find(kWarnings, reason) != std::end(kWarnings);
    return warns ? ESeverity::Warning : ESeverity::Error;
}

} // namespace

void CFindings::Add(EFailure reason, size_t line, std::string name)
{
    Add({reason, line, std::move(name), SeverityOf(reason), IsMended(reason)});
}

void CFindings::AddUnmended(EFailure reason, size_t line, std::string name)
{
    Add({reason, line, std::move(name), SeverityOf(reason)});
}

void CFindings::Add(const Finding& finding)
{
    const auto isAlike = [&](const Finding& kept) {
        return kept.reason == finding.reason && kept.mendable == finding.mendable;
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

bool CFindings::Has(EFailure reason) const
{
    return std::ranges::find(m_kFindings, reason, &Finding::reason) != m_kFindings.end();
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
