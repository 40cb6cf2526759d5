#pragma once

#include <cstdint>
#include <string>

namespace gw {

/// How many instances of the program run, as one word that all processes of a user share. It is -1 while none
/// runs. Whoever crashes leaves its share in it until the machine starts anew, and later starts take
/// themselves for further instances: Reset is the way out. Where the system shares no memory, the word is the
/// process's own and each instance takes itself for the first.
class CInstanceCounter
{
public:
    /// Processes that give the same name, without a slash, share the same word.
    explicit CInstanceCounter(const std::string& name = "gaitwright-instances");
    ~CInstanceCounter();
    CInstanceCounter(const CInstanceCounter&) = delete;
    CInstanceCounter& operator=(const CInstanceCounter&) = delete;

    /// Adds 1 and answers the new value: 0 for the first instance.
    int32_t Enter();
    /// Takes 1 off.
    void Leave();
    /// Back to -1, whoever runs.
    void Reset();
    int32_t Value() const;

    /// What the system knows the word by.
    const std::string& SharedName() const { return m_kSharedName; }

private:
    std::string m_kSharedName;
    int32_t m_iOwn = 0; // in place of the shared one
    int32_t* m_piCount; // instances, from 0 on: memory that the system has just made is right as it is
};

} // namespace gw
