#pragma once

#include <cstdint>
#include <memory>
#include <string>

namespace gw {

/// Counts the running instances of the program in one word of shared memory per user; -1 while none runs. A
/// crashed instance stays counted until the machine restarts, so later starts believe that they are not the
/// first; Reset fixes that. Without shared memory, the word is local and each instance believes that it is
/// the first.
class CInstanceCounter
{
public:
    /// Processes that use the same name (without a slash) share the same word.
    explicit CInstanceCounter(const std::string& name = "gaitwright-instances");
    CInstanceCounter(const CInstanceCounter&) = delete;
    CInstanceCounter& operator=(const CInstanceCounter&) = delete;

    /// Adds 1 and returns the new value: 0 for the first instance.
    int32_t Enter();
    /// Subtracts 1.
    void Leave();
    /// Resets the word to -1, whatever is running.
    void Reset();
    int32_t Value() const;

    /// Returns the system's name of the word.
    const std::string& SharedName() const { return m_kSharedName; }

private:
    std::string m_kSharedName;
    std::shared_ptr<int32_t> m_spiCount; // of instances; the system zeroes new memory
};

} // namespace gw
