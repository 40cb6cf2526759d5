#pragma once

#include "CMappedFile.h"

#include <cstddef>
#include <cstdint>
#include <cstdio>
#include <span>
#include <string>

namespace gw {

/// The input of a picture: a regular file or a block of memory, fully available, or the standard input, which
/// can be endless and may not support seeking.
class CPicInput
{
public:
    CPicInput() = default;
    /// Reads a block owned by the caller.
    explicit CPicInput(std::span<const std::byte> bytes) : m_kBytes(bytes) {}
    CPicInput(const CPicInput&) = delete;
    CPicInput& operator=(const CPicInput&) = delete;

    /// Opens a file, or the standard input in binary mode if the stem of the name is "-". Returns false if it
    /// cannot be read.
    bool Open(const std::string& fileName);
    bool IsStream() const { return m_pkStream != nullptr; }

    /// Reads all requested bytes, or returns false.
    bool Read(std::span<std::byte> bytes);
    template <class T>
    bool ReadValue(T& value)
    {
        return Read(std::as_writable_bytes(std::span(&value, 1)));
    }
    /// Moves to a position; only forward on a stream without seeking.
    bool Seek(uint64_t position);
    bool Skip(uint64_t byteCount) { return Seek(m_uiPosition + byteCount); }
    uint64_t Position() const { return m_uiPosition; }
    /// Returns whether that many bytes can follow; always true for a stream.
    bool MayHold(uint64_t byteCount) const
    {
        return IsStream() || (m_uiPosition <= m_kBytes.size() && byteCount <= m_kBytes.size() - m_uiPosition);
    }

private:
    CMappedFile m_kFile;
    std::span<const std::byte> m_kBytes;
    std::FILE* m_pkStream = nullptr; // the standard input, which is not closed
    long m_iStreamStart = -1;        // start of the picture in it, or -1 without seeking
    uint64_t m_uiPosition = 0;       // relative to the picture's start
};

/// Returns whether a name means the standard streams: "-.bmp".
bool IsStandardStream(const std::string& fileName);

} // namespace gw
