#pragma once

#include "Notice.h"
#include "gaitwright/gaitwright.h"

#include <exception>
#include <new>
#include <stdexcept>
#include <string>
#include <utility>
#include <vector>

namespace gw {
class CFailureRecord;
}

namespace gaitwright {

Failure FailureOf(const gw::Notice& notice);
/// Returns a failure with its code, about no file.
Failure FailureOf(const char* reason, const std::string& words);
/// Returns the failure recorded by a reader or a writer.
Failure FailureOf(const std::string& path, const gw::CFailureRecord& record);

/// Collects the notices of an operation.
class CNotices
{
public:
    void Add(const gw::Notice& notice);
    /// Returns whether any of them is an error.
    bool HasFailed() const { return hasFailed_; }
    /// Returns the first error.
    Failure FirstError() const;
    /// Returns all warnings, in order.
    std::vector<Failure> Warnings() const;

private:
    std::vector<gw::Notice> notices_;
    bool hasFailed_ = false;
};

/// These allocate nothing.
Failure OutOfMemory() noexcept;
Failure InternalFailure(const std::exception& reason) noexcept;

/// Calls a function that returns an outcome. No exception passes: one becomes a failure.
template <class Function>
auto Guarded(Function function) noexcept -> decltype(function())
{
    try
    {
        return function();
    } catch (const std::bad_alloc&)
    {
        return OutOfMemory();
    } catch (const std::length_error&) // larger than any memory
    {
        return OutOfMemory();
    } catch (const std::exception& reason)
    {
        return InternalFailure(reason);
    }
}

} // namespace gaitwright
