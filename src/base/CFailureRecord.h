#pragma once

#include "Finding.h"

#include <cstddef>
#include <string>
#include <vector>

namespace gw {

/// The failures of one stream: the first error, and the warnings.
class CFailureRecord
{
public:
    /// Records the first failure and ignores later ones. If a system call failed, records the system's reason
    /// too. Always returns false, so that `return record.Fail(...)` works.
    bool Fail(EFailure reason, size_t where = 0, std::string name = {});
    /// Records a failure from another record.
    bool Fail(const Finding& failure);
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
