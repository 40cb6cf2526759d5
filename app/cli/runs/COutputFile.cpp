#include "COutputFile.h"

#include "CMappedFile.h"
#include "Files.h"
#include "LiveNames.h"
#include "Output.h"
#include "Paths.h"
#include "ShellOptions.h"
#include "Streams.h"
#include "SystemError.h"
#include "TemporaryFiles.h"
#include "Terminal.h"
#include "Words.h"

#include <algorithm>
#include <array>
#include <cstdio>

namespace gw {

namespace {

// The formats that no terminal can show.
constexpr std::array kBinary{".Kinetra", ".orn", ".glb", ".npy"};

bool IsForTerminal(std::string_view path)
{
    return std::ranges::none_of(kBinary, [&](const char* binary) { return HasExtension(path, binary); });
}

} // namespace

bool COutputFile::Open(const ShellOptions& options, const std::string& path, std::string_view extension)
{
    if (!IsStream(path) && !MayWrite(options, path))
        return false;
    const bool isOpen = Open(path, extension);
    if (!isOpen)
        SayNotice(options, m_kFailure);
    return isOpen;
}

bool COutputFile::Open(const std::string& path, std::string_view extension)
{
    Remove();
    m_kPath = path;
    if (!IsStream(path))
        return true;
    if (IsStandardOutput(path) && IsTerminal(stdout) && !IsForTerminal(extension))
        return Fail("a terminal cannot show this format; redirect standard output to a file or a program");
    return Create(extension) || Fail("a temporary file cannot be written" + TakeSystemErrorWords());
}

// Writers replace the file by another one of that name, which no lock protects. So the name is not a private
// one, which other programs sweep.
bool COutputFile::Create(std::string_view extension)
{
    const std::string path = CreateTemporaryFile(extension);
    if (path.empty())
        return false;
    m_kCopy = path;
    m_iLiveName = AddLiveName(m_kCopy);
    return true;
}

void COutputFile::Remove()
{
    if (m_kCopy.empty())
        return;
    RemoveFile(m_kCopy.c_str());
    RemoveLiveName(m_iLiveName);
    m_kCopy.clear();
}

bool COutputFile::Fail(const std::string& words)
{
    m_kFailure = MakeNotice(m_kPath, "write-error", words);
    return false;
}

bool COutputFile::Deliver()
{
    if (m_kCopy.empty())
        return true;
    CMappedFile written;
    if (written.Open(m_kCopy) != EFailure::None)
        return Fail("the temporary file cannot be read" + TakeSystemErrorWords());
    ClearLastSystemError();
    std::FILE* const stream = IsStandardOutput(m_kPath) ? stdout
                                                        : StreamOf(OpenFile(m_kPath, EOpen::WriteStream),
                                                                   "w"); // never creates a file
    if (!stream)
        return Fail("this cannot be opened" + SystemErrorWords(LastSystemError()));
    const std::string_view text = written.Text();
    const bool isWritten = std::fwrite(text.data(), 1, text.size(), stream) == text.size();
    const int error = LastSystemError();
    const bool isFlushed = stream == stdout ? std::fflush(stream) == 0 : std::fclose(stream) == 0;
    if (isWritten && isFlushed)
        return true;
    if (stream == stdout)
        std::clearerr(stdout); // reported here
    return Fail("this cannot be written" + SystemErrorWords(isWritten ? LastSystemError() : error));
}

bool COutputFile::DeliverOrSay()
{
    const bool isDelivered = Deliver();
    if (!isDelivered)
        SayError(m_kFailure.path, m_kFailure.code.c_str(), m_kFailure.words);
    return isDelivered;
}

} // namespace gw
