#pragma once

#include "Finding.h"

#include <cstddef>
#include <string>
#include <vector>

namespace gw {

/// The findings of a file. For each fault, the first few places are kept and the rest only counted, so a file
/// with faults everywhere takes no more memory than a correct one.
class CFindings
{
public:
    /// Adds a fault, with the severity of its kind. A repaired copy does not have it if such faults can be
    /// repaired.
    void Add(EFailure reason, size_t line, std::string name = {});
    /// Adds a fault that remains in a repaired copy.
    void AddUnmended(EFailure reason, size_t line, std::string name = {});
    /// Adds a failure or warning of a reader.
    void Add(const Finding& finding);

    /// Returns all findings by line; those about the whole file first.
    std::vector<Finding> Sorted() const;
    bool Has(EFailure reason) const;
    bool HasErrors() const;
    /// Returns whether there is an error or a warning.
    bool HasFaults() const;
    /// Returns whether a repaired copy fixes at least one error or warning.
    bool MendsAny() const;

private:
    std::vector<Finding> m_kFindings;
};

} // namespace gw
