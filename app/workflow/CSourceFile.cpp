// Readers need files: they select the format by the extension, map the bytes and may read them twice. A pipe
// has neither an extension nor a second reading, so its bytes go to a temporary file. The first ones decide
// the format, so that a stream without end, such as a device of zeros, is refused before it fills the disk.

#include "CSourceFile.h"

#include "CCustomData.h"
#include "CMappedFile.h"
#include "COrrinStream.h"
#include "Files.h"
#include "FindingWords.h"
#include "PackageBlocks.h"
#include "Paths.h"
#include "Streams.h"
#include "SystemError.h"

#include <algorithm>

namespace gw {

namespace {

constexpr int kStandardInput = 0;
constexpr size_t kStartBytes = size_t{1} << 16; // enough to find the format
constexpr size_t kPieceBytes = size_t{1} << 18;
constexpr uint64_t kStreamLimit = uint64_t{1} << 32; // larger than any motion that fits into memory

// Appends up to `size` bytes; returns false at a failed read. At the end, fewer bytes arrive.
bool ReadPiece(int file, size_t size, std::string& bytes)
{
    const size_t end = bytes.size() + size;
    size_t done = bytes.size();
    bytes.resize(end);
    while (done < end)
    {
        const ptrdiff_t count = ReadSome(file, bytes.data() + done, end - done);
        if (count <= 0)
        {
            bytes.resize(done);
            return count == 0;
        }
        done += static_cast<size_t>(count);
    }
    return true;
}

bool IsPackageName(const std::string& path)
{
    return HasExtension(path, ".Kinetra") || HasExtension(path, ".orn");
}

// Closes a descriptor, except standard input.
class COpenedStream
{
public:
    explicit COpenedStream(const std::string& path)
        : m_bOwned(path != kStandardStream),
          m_iFile(m_bOwned ? OpenFile(path, EOpen::ReadStream) : kStandardInput)
    {
    }
    ~COpenedStream()
    {
        if (m_bOwned && m_iFile >= 0)
            CloseFile(m_iFile);
    }
    COpenedStream(const COpenedStream&) = delete;
    COpenedStream& operator=(const COpenedStream&) = delete;
    int File() const { return m_iFile; }

private:
    bool m_bOwned;
    int m_iFile;
};

} // namespace

bool CSourceFile::Open(const std::string& path, EPackage package)
{
    m_kCopy.Remove();
    m_kPath = path;
    if (IsStream(path) && !CopyStream(path))
        return false;
    return package == EPackage::Kept || !IsPackageName(m_kPath) || Unpack(path);
}

bool CSourceFile::Fail(const std::string& path, const char* code, const std::string& words)
{
    m_kCopy.Remove();
    m_kFailure = MakeNotice(path, code, words);
    return false;
}

bool CSourceFile::FailToCopy(const std::string& path)
{
    return Fail(path, "no-temporary-file",
                "a temporary file cannot be written" + TakeSystemErrorWords() +
                    " (TMPDIR can name another folder)");
}

bool CSourceFile::CopyStream(const std::string& path)
{
    const COpenedStream stream(path);
    std::string start;
    if (stream.File() < 0 || !ReadPiece(stream.File(), kStartBytes, start))
        return Fail(path, "read-error", "this cannot be read" + SystemErrorWords(LastSystemError()));
    if (start.empty())
        return Fail(path, "empty", "there is nothing to read");
    const std::string_view extension = ExtensionOfContent(start);
    if (extension.empty())
        return Fail(path, "unknown-format",
                    "a pipe or device whose first bytes are not those of a motion file");
    if (!m_kCopy.CreateTemporary(extension) || !CopyRest(stream.File(), start, path))
        return !m_kFailure.words.empty() ? false : FailToCopy(path);
    m_kPath = m_kCopy.Path();
    return true;
}

bool CSourceFile::CopyRest(int file, std::string& start, const std::string& path)
{
    uint64_t size = 0;
    std::string& piece = start;
    while (!piece.empty())
    {
        size += piece.size();
        if (size > kStreamLimit)
            return Fail(path, "too-large", "more than 4 GB arrived, which is too much for a motion");
        if (!WriteAll(m_kCopy.File(), piece))
            return false;
        piece.clear();
        if (!ReadPiece(file, kPieceBytes, piece))
            return Fail(path, "read-error", "the end cannot be read" + SystemErrorWords(LastSystemError()));
    }
    return true;
}

// Other containers are left as they are, and those without the name of the block are not even read: they can
// be large.
bool CSourceFile::Unpack(const std::string& path)
{
    const bool isPackage = HasExtension(m_kPath, ".Kinetra");
    CMappedFile bytes;
    if (!isPackage &&
        (bytes.Open(m_kPath) != EFailure::None || bytes.Text().find("MotionInfo") == std::string_view::npos))
        return true;
    COrrinStream scene;
    scene.SetPictureLimit(0);
    scene.LoadFile(m_kPath, false);
    return (!isPackage && !FindPackage(scene).file) || OpenInside(path, scene);
}

bool CSourceFile::OpenInside(const std::string& path, const COrrinStream& scene)
{
    const PackageBlocks blocks = FindPackage(scene);
    PackageFacts facts;
    if (blocks.file && ReadPackageFacts(*blocks.info, facts))
        return CopyBytes(path, blocks.file->Data(), FormatExtension(facts.format));
    const Finding& failure = scene.Record().Failure();
    m_kFailure = MakeNotice(path, failure ? failure : Finding{EFailure::Empty, 0, "MotionFile"});
    return false;
}

bool CSourceFile::CopyBytes(const std::string& path, std::span<const std::byte> bytes,
                            std::string_view extension)
{
    if (!m_kCopy.CreateTemporary(extension) ||
        !WriteAll(m_kCopy.File(), {reinterpret_cast<const char*>(bytes.data()), bytes.size()}))
        return FailToCopy(path);
    m_kPath = m_kCopy.Path();
    return true;
}

} // namespace gw
