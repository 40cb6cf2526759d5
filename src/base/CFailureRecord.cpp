#include "CFailureRecord.h"

#include <algorithm>

namespace gw {

void CFailureRecord::Warn(EFailure reason, size_t where, std::string name)
{
    if (std::ranges::count(m_kWarnings, reason, &Finding::reason) < kWarningsPerReason)
        m_kWarnings.push_back({reason, where, std::move(name), ESeverity::Warning});
}

} // namespace gw
