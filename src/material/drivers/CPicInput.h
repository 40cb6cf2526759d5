#pragma once

#include "CMappedFile.h"

#include <cstddef>
#include <cstdint>
#include <cstdio>
#include <span>
#include <string>

namespace gw {

/// The bytes of a picture: a regular file's, which are all at hand, a block of memory's, or those that come
/// on the standard input, of which there may be no end and no way back.
class CPicInput
{
public:
    CPicInput() = default;
    /// Reads a block that the caller keeps.
    explicit CPicInput(std::span<const std::byte> bytes) : m_kBytes(bytes) {}
    CPicInput(const CPicInput&) = delete;
    CPicInput& operator=(const CPicInput&) = delete;

    /// A file, or the standard input in binary mode for a name whose stem is "-". False where it cannot be
    /// read.
    bool Open(const std::string& fileName);
    bool IsStream() const { return m_pkStream != nullptr; }

    /// All the bytes that are asked for, or false.
    bool Read(std::span<std::byte> bytes);
    template <class T>
    bool ReadValue(T& value)
    {
        return Read(std::as_writable_bytes(std::span(&value, 1)));
    }
    /// Goes on to a place. On a stream that cannot go back, only forward.
    bool Seek(uint64_t position);
    bool Skip(uint64_t byteCount) { return Seek(m_uiPosition + byteCount); }
    uint64_t Position() const { return m_uiPosition; }
    /// Whether as many bytes may still come; a stream does not tell.
    bool MayHold(uint64_t byteCount) const
    {
        return IsStream() || (m_uiPosition <= m_kBytes.size() && byteCount <= m_kBytes.size() - m_uiPosition);
    }

private:
    CMappedFile m_kFile;
    std::span<const std::byte> m_kBytes;
    std::FILE* m_pkStream = nullptr; // the standard input, which is not closed
    long m_iStreamStart = -1;        // where the picture begins in it, or -1 where it cannot go back
    uint64_t m_uiPosition = 0;       // from the picture's start
};

/// Whether a name stands for the standard streams: "-.bmp".
bool IsStandardStream(const std::string& fileName);

} // namespace gw
