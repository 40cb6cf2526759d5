#pragma once

// The system's calls, without the macros that take names of this program.

#define WIN32_LEAN_AND_MEAN // NOMINMAX comes with the standard library
#include <windows.h>

#undef DeleteFile
#undef LockFile
#undef GetObject

#include "WideText.h"

#include <span>
#include <string>
#include <string_view>

namespace gw {

/// Converts a path for a call of the system. A long one becomes a full path with the prefix that lifts the
/// system's limit of 260 characters.
std::wstring WidePath(std::string_view path);
/// Same for a path that is not long, without allocating; false if it does not fit.
bool WidePath(const char* path, wchar_t (&wide)[4096]);

/// Returns a command line that the C library of a program splits into these arguments again.
std::wstring CommandLine(std::span<const std::string> arguments);

/// What others may do with a file that is open: all that they may on other systems.
inline constexpr DWORD kShareAll = FILE_SHARE_READ | FILE_SHARE_WRITE | FILE_SHARE_DELETE;

/// A handle of the system that is closed with the object. Null and invalid handles are none.
class CHandle
{
public:
    CHandle() = default;
    explicit CHandle(HANDLE handle) : m_pkHandle(handle == INVALID_HANDLE_VALUE ? nullptr : handle) {}
    ~CHandle() { Close(); }
    CHandle(const CHandle&) = delete;
    CHandle& operator=(const CHandle&) = delete;

    HANDLE Get() const { return m_pkHandle; }
    /// Returns where a call stores a new handle.
    HANDLE* Place() { return &m_pkHandle; }
    explicit operator bool() const { return m_pkHandle != nullptr; }
    /// Keeps the code of the last error.
    void Close();

private:
    HANDLE m_pkHandle = nullptr;
};

} // namespace gw
