#pragma once

#include "CPrivateFile.h"
#include "Notice.h"

#include <cstddef>
#include <span>
#include <string>
#include <string_view>

namespace gw {

class COrrinStream;

/// Whether the motion inside a Kinetra file is the source.
enum class EPackage : uint8_t
{
    Kept,
    Unpacked,
};

/// A source as a file that readers can open by its extension, any number of times. Standard input, pipes and
/// devices are copied to a temporary file first, and so is the motion inside a Kinetra file. The copy is
/// deleted with the object.
class CSourceFile
{
public:
    /// Returns false, with the reason in Failure(), if a copy is needed and cannot be made.
    bool Open(const std::string& path, EPackage package = EPackage::Kept);
    /// Opens the motion inside a Kinetra file that is loaded. Returns false, with the reason about `path` in
    /// Failure(), if there is none, or if it cannot be copied.
    bool OpenInside(const std::string& path, const COrrinStream& scene);

    /// Returns the file to read.
    const std::string& Path() const { return m_kPath; }
    bool IsCopy() const { return !m_kCopy.Path().empty(); }
    const Notice& Failure() const { return m_kFailure; }

private:
    bool CopyStream(const std::string& path);
    bool CopyRest(int file, std::string& start, const std::string& path);
    bool Unpack(const std::string& path);
    bool CopyBytes(const std::string& path, std::span<const std::byte> bytes, std::string_view extension);
    bool FailToCopy(const std::string& path);
    bool Fail(const std::string& path, const char* code, const std::string& words);

    std::string m_kPath;
    CPrivateFile m_kCopy;
    Notice m_kFailure;
};

} // namespace gw
