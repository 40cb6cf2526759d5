#include "Writing.h"

#include "CMappedFile.h"
#include "CPrivateFile.h"
#include "CSafeFile.h"
#include "FindingWords.h"
#include "SystemError.h"
#include "Text.h"

#include <span>

namespace gaitwright {

namespace {

constexpr std::string_view kExists = "exists";

// For the time of one operation: a writer that fails before it opens the file leaves no mark.
class CKeptPath
{
public:
    explicit CKeptPath(const std::string& path) : m_kPath(path) { gw::CSafeFile::KeepExisting(path); }
    CKeptPath(const CKeptPath&) = delete;
    CKeptPath& operator=(const CKeptPath&) = delete;
    ~CKeptPath() { gw::CSafeFile::ReplaceExisting(m_kPath); }

private:
    const std::string& m_kPath;
};

Failure NoTemporaryFile()
{
    return FailureOf("no-temporary-file", "a temporary file cannot be written" + gw::TakeSystemErrorWords() +
                                              " (TMPDIR can name another folder)");
}

} // namespace

Outcome<void> WriteFile(const std::string& path, Existing existing, const Writer& write)
{
    if (existing == Existing::Replace)
        return write(path);
    const CKeptPath kept(path);
    Outcome<void> written = write(path);
    if (written || written.Error().reason != kExists)
        return written;
    Failure failure = written.Error();
    failure.words = "the file exists"; // without the shell's option
    return failure;
}

// Writers replace files by name, so the bytes pass through one.
Outcome<std::vector<std::byte>> BytesOf(std::string_view extension, const Writer& write)
{
    gw::CPrivateFile file;
    if (!file.CreateTemporary(extension))
        return NoTemporaryFile();
    const Outcome<void> written = write(file.Path());
    if (!written)
        return written.Error();
    gw::CMappedFile mapped;
    if (mapped.Open(file.Path()) != gw::EFailure::None)
        return NoTemporaryFile();
    const auto bytes = std::as_bytes(std::span(mapped.Text()));
    return std::vector<std::byte>(bytes.begin(), bytes.end());
}

Outcome<void> WriteText(const std::string& path, const std::function<bool(const gw::CTextSink&)>& send)
{
    gw::CSafeFile file;
    if (file.Open(path) && send([&](std::string_view text) { return file.Write(text); }) && file.Commit())
        return {};
    const gw::EFailure reason =
        file.Failure() == gw::EFailure::None ? gw::EFailure::WriteError : file.Failure();
    return FailureOf(gw::MakeNotice(path, {.reason = reason, .systemError = gw::TakeSystemError()}));
}

std::string ExtensionOf(std::string_view format)
{
    const std::string extension = gw::LowerCase(std::string(format));
    return extension.starts_with('.') ? extension : '.' + extension;
}

} // namespace gaitwright
