#pragma once

#include "CFailure.h"
#include "Fault.h"

#include <cstddef>
#include <string>
#include <vector>

namespace gw {

/// One fault of a file, at one place.
struct Finding
{
    EFault fault = EFault::Reader;
    size_t where = 0; ///< line from 1 on of a text, byte of a container; 0 where there is none
    std::string name; ///< joint, keyword or text concerned; may be empty
    ESeverity severity = ESeverity::Error;
    bool mendable = false;            ///< a mended copy is free of it
    EFailure reason = EFailure::None; ///< what the reader said, for EFault::Reader
    size_t more = 0;                  ///< further findings like this one, which are only counted
};

/// What was found in a file. Of each fault the first few places are kept and the others are counted, so that
/// a file that is wrong in every value takes no more memory than one that is right.
class CFindings
{
public:
    /// A fault that a mended copy is free of where the table of faults says so.
    void Add(EFault fault, size_t line, std::string name = {});
    /// A fault that stays in a mended copy.
    void AddUnmended(EFault fault, size_t line, std::string name = {});
    /// What a reader failed on or warned of.
    void AddReader(const CFailure& failure, ESeverity severity);

    /// All findings by line; those of the file as a whole first.
    std::vector<Finding> Sorted() const;
    bool Has(EFault fault) const;
    bool HasErrors() const;
    /// Whether there is an error or a warning.
    bool HasFaults() const;
    /// Whether a mended copy is free of one error or warning at least.
    bool MendsAny() const;

private:
    void Keep(const Finding& finding);

    std::vector<Finding> m_kFindings;
};

} // namespace gw
