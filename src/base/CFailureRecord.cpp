#include "CFailureRecord.h"

#include "SystemError.h"

#include <algorithm>
#include <utility>

namespace gw {

bool CFailureRecord::Fail(EFailure reason, size_t where, std::string name)
{
    if (m_kFailure)
        return false;
    m_kFailure = {reason, where, std::move(name)};
    if (IsOfSystem(reason))
        m_kFailure.systemError = TakeSystemError();
    return false;
}

bool CFailureRecord::Fail(const Finding& failure)
{
    if (!m_kFailure)
        m_kFailure = failure;
    return false;
}

void CFailureRecord::Warn(EFailure reason, size_t where, std::string name)
{
    if (std::ranges::count(m_kWarnings, reason, &Finding::reason) < kWarningsPerReason)
        m_kWarnings.push_back({reason, where, std::move(name), ESeverity::Warning});
}

} // namespace gw
