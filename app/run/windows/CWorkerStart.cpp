// The worker's side of its start. Until it serves, its standard streams lead nowhere, so that making the
// handler again repeats no message of the program.

#include "CWorkerStart.h"

#include "CInterrupt.h"
#include "Text.h"
#include "WindowsCalls.h"

#include <charconv>
#include <cstdlib>

#include <io.h>

namespace gw {

namespace {

bool ReadNumber(std::string_view& rest, uint64_t& number)
{
    const std::string_view word = NextToken(rest, ",");
    const auto [end, error] = std::from_chars(word.data(), word.data() + word.size(), number, 16);
    return error == std::errc() && end == word.data() + word.size();
}

std::string Digits(uint64_t number)
{
    char digits[17];
    return {digits, std::to_chars(digits, std::end(digits), number, 16).ptr};
}

// Returns a descriptor of the C library, which does not change line ends.
int DescriptorOf(void* handle)
{
    return _open_osfhandle(reinterpret_cast<intptr_t>(handle), 0);
}

bool Redirect(std::FILE* stream, void* handle)
{
    std::fflush(stream);
    return _dup2(DescriptorOf(handle), _fileno(stream)) == 0;
}

} // namespace

std::string CWorkerStart::Text() const
{
    std::string text;
    for (const void* handle : handles)
        text += Digits(reinterpret_cast<uintptr_t>(handle)) + ',';
    return text + Digits(taskBytes) + ',' + Digits(static_cast<uint64_t>(commit));
}

bool CWorkerStart::Read(std::string_view text)
{
    uint64_t number = 0;
    for (void*& handle : handles)
    {
        if (!ReadNumber(text, number))
            return false;
        handle = reinterpret_cast<void*>(static_cast<uintptr_t>(number));
    }
    if (!ReadNumber(text, taskBytes) || !ReadNumber(text, number))
        return false;
    commit = static_cast<ECommit>(number);
    return true;
}

std::string CWorkerStart::Description() const
{
    const void* const memory = MapViewOfFile(handles[Task], FILE_MAP_READ, 0, 0, 0);
    if (!memory)
        return {};
    std::string text(static_cast<const char*>(memory), taskBytes);
    UnmapViewOfFile(memory);
    return text;
}

void CWorkerStart::Serve(CJobHandler& handler) const
{
    CInterrupt::Ignore();
    SetErrorMode(SEM_FAILCRITICALERRORS | SEM_NOGPFAULTERRORBOX |
                 SEM_NOOPENFILEERRORBOX); // the program reports it
    std::FILE* const record = _fdopen(DescriptorOf(handles[Record]), "ab");
    if (record && Redirect(stdout, handles[Output]) && Redirect(stderr, handles[Words]))
        CWorkerLoop(handler, {handles[Orders], handles[Replies], handles[Event]}, record, commit).Run();
    std::_Exit(0); // the program cleans up
}

} // namespace gw
