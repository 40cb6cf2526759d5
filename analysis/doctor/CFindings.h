#pragma once

#include "CFailure.h"
#include "Fault.h"

#include <cstddef>
#include <string>
#include <vector>

namespace gw {

/// One fault at one place in a file.
struct Finding
{
    EFault fault = EFault::Reader;
    size_t where = 0; ///< line of a text, starting at 1, or byte of a container; 0 if unknown
    std::string name; ///< the joint, keyword or text concerned; can be empty
    ESeverity severity = ESeverity::Error;
    bool mendable = false;            ///< fixed in a repaired copy
    EFailure reason = EFailure::None; ///< the reader's reason, for EFault::Reader
    size_t more = 0;                  ///< number of further findings like this one
};

/// The findings of a file. For each fault, the first few places are kept and the rest only counted, so a file
/// with faults everywhere takes no more memory than a correct one.
class CFindings
{
public:
    /// Adds a fault, which a repaired copy fixes if the fault table says so.
    void Add(EFault fault, size_t line, std::string name = {});
    /// Adds a fault that remains in a repaired copy.
    void AddUnmended(EFault fault, size_t line, std::string name = {});
    /// Adds a failure or warning of a reader.
    void AddReader(const CFailure& failure, ESeverity severity);

    /// Returns all findings by line; those about the whole file first.
    std::vector<Finding> Sorted() const;
    bool Has(EFault fault) const;
    bool HasErrors() const;
    /// Returns whether there is an error or a warning.
    bool HasFaults() const;
    /// Returns whether a repaired copy fixes at least one error or warning.
    bool MendsAny() const;

private:
    void Keep(const Finding& finding);

    std::vector<Finding> m_kFindings;
};

} // namespace gw
