#pragma once

#include "Finding.h"

#include <cstddef>
#include <string>
#include <utility>
#include <vector>

namespace gw {

/// The failures of one stream: the first error, and the warnings.
class CFailureRecord
{
public:
    /// Records the first failure and ignores later ones. Always returns false, so that `return
    /// record.Fail(...)` works.
    bool Fail(EFailure reason, size_t where = 0, std::string name = {})
    {
        if (!m_kFailure)
            m_kFailure = {reason, where, std::move(name)};
        return false;
    }
    /// Records a warning. Only the first kWarningsPerReason of each reason are kept.
    void Warn(EFailure reason, size_t where = 0, std::string name = {});
    void Clear() { *this = {}; }

    const Finding& Failure() const { return m_kFailure; }
    const std::vector<Finding>& Warnings() const { return m_kWarnings; }

private:
    static constexpr int kWarningsPerReason = 8;

    Finding m_kFailure;
    std::vector<Finding> m_kWarnings;
};

} // namespace gw
