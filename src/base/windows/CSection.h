#pragma once

#include <cstddef>
#include <mutex>

namespace gw {

/// A lock within this process; see std::lock_guard. It is a critical section of the system.
class CSection
{
public:
    CSection();
    ~CSection();
    CSection(const CSection&) = delete;
    CSection& operator=(const CSection&) = delete;

    void lock();
    void unlock();

private:
    alignas(void*) std::byte m_kSection[40]; // without the system's header, which is large
};

} // namespace gw
