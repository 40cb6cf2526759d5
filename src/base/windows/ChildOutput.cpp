#include "ChildOutput.h"

#include "WindowsCalls.h"

#include <array>
#include <chrono>

namespace gw {

namespace {

using Clock = std::chrono::steady_clock;

constexpr DWORD kGlanceMilliseconds = 2;
constexpr std::chrono::milliseconds kCallPeriod(100);
constexpr DWORD kPatienceMilliseconds = 5000;
constexpr DWORD kFirstCrashCode = 0xC0000000; // codes of the system for a process that it ended

// The handles that a new process inherits, and no others.
class CInherited
{
public:
    explicit CInherited(std::array<HANDLE, 2> handles) : m_kHandles(handles)
    {
        SIZE_T size = 0;
        InitializeProcThreadAttributeList(nullptr, 1, 0, &size);
        m_kBytes.resize(size);
        InitializeProcThreadAttributeList(List(), 1, 0, &size);
        UpdateProcThreadAttribute(List(), 0, PROC_THREAD_ATTRIBUTE_HANDLE_LIST, m_kHandles.data(),
                                  sizeof m_kHandles, nullptr, nullptr);
    }
    ~CInherited() { DeleteProcThreadAttributeList(List()); }
    CInherited(const CInherited&) = delete;
    CInherited& operator=(const CInherited&) = delete;

    LPPROC_THREAD_ATTRIBUTE_LIST List()
    {
        return reinterpret_cast<LPPROC_THREAD_ATTRIBUTE_LIST>(m_kBytes.data());
    }

private:
    std::array<HANDLE, 2> m_kHandles;
    std::vector<std::byte> m_kBytes;
};

SECURITY_ATTRIBUTES Inheritable()
{
    return {sizeof(SECURITY_ATTRIBUTES), nullptr, TRUE};
}

std::string WithExtension(const std::string& program)
{
    return program.ends_with(".exe") ? program : program + ".exe";
}

// Starts the program in a job that ends it together with everything that it starts. Returns false on failure.
bool Start(const std::string& program, const std::vector<std::string>& arguments, HANDLE output, HANDLE job,
           CHandle& process)
{
    SECURITY_ATTRIBUTES inheritable = Inheritable();
    const CHandle nothing(CreateFileW(L"NUL", GENERIC_READ | GENERIC_WRITE, kShareAll, &inheritable,
                                      OPEN_EXISTING, 0, nullptr));
    CInherited inherited({nothing.Get(), output});
    STARTUPINFOEXW start = {};
    start.StartupInfo.cb = sizeof start;
    start.StartupInfo.dwFlags = STARTF_USESTDHANDLES;
    start.StartupInfo.hStdInput = nothing.Get();
    start.StartupInfo.hStdOutput = output;
    start.StartupInfo.hStdError = nothing.Get();
    start.lpAttributeList = inherited.List();
    std::vector<std::string> texts{program};
    texts.insert(texts.end(), arguments.begin(), arguments.end());
    std::wstring line = CommandLine(texts);
    PROCESS_INFORMATION started = {};
    if (!CreateProcessW(WidePath(WithExtension(program)).c_str(), line.data(), nullptr, nullptr, TRUE,
                        CREATE_SUSPENDED | CREATE_NO_WINDOW | EXTENDED_STARTUPINFO_PRESENT, nullptr, nullptr,
                        &start.StartupInfo, &started))
        return false;
    *process.Place() = started.hProcess;
    const CHandle thread(started.hThread);
    AssignProcessToJobObject(job, process.Get());
    ResumeThread(thread.Get());
    return true;
}

// Reads until the program closes its output. Returns Finished at that point.
EChildEnd Collect(HANDLE pipe, const ChildLimits& limits, std::vector<std::byte>& output,
                  const std::function<void()>& wait)
{
    const Clock::time_point end = Clock::now() + std::chrono::duration_cast<Clock::duration>(
                                                     std::chrono::duration<double>(limits.seconds));
    std::array<std::byte, 1 << 16> piece;
    Clock::time_point nextCall = Clock::now() + kCallPeriod;
    while (Clock::now() < end)
    {
        DWORD count = 0;
        if (!PeekNamedPipe(pipe, nullptr, 0, nullptr, &count, nullptr))
            return GetLastError() == ERROR_BROKEN_PIPE ? EChildEnd::Finished : EChildEnd::Died;
        if (count == 0)
        {
            Sleep(kGlanceMilliseconds);
            if (wait && Clock::now() >= nextCall)
            {
                wait(); // if that throws, the job ends the program
                nextCall = Clock::now() + kCallPeriod;
            }
            continue;
        }
        if (!ReadFile(pipe, piece.data(), static_cast<DWORD>(piece.size()), &count, nullptr))
            return EChildEnd::Died;
        if (output.size() + count > limits.outputBytes)
            return EChildEnd::TooMuch;
        output.insert(output.end(), piece.begin(), piece.begin() + count);
    }
    return EChildEnd::TimedOut;
}

} // namespace

EChildEnd RunChild(const std::string& program, const std::vector<std::string>& arguments,
                   const ChildLimits& limits, std::vector<std::byte>& output,
                   const std::function<void()>& wait)
{
    output.clear();
    const CHandle job(CreateJobObjectW(nullptr, nullptr));
    JOBOBJECT_EXTENDED_LIMIT_INFORMATION jobLimits = {};
    jobLimits.BasicLimitInformation.LimitFlags = JOB_OBJECT_LIMIT_KILL_ON_JOB_CLOSE;
    SetInformationJobObject(job.Get(), JobObjectExtendedLimitInformation, &jobLimits, sizeof jobLimits);

    SECURITY_ATTRIBUTES inheritable = Inheritable();
    CHandle pipe, writeEnd, process;
    if (!CreatePipe(pipe.Place(), writeEnd.Place(), &inheritable, 0))
        return EChildEnd::Missing;
    SetHandleInformation(pipe.Get(), HANDLE_FLAG_INHERIT, 0);
    if (!Start(program, arguments, writeEnd.Get(), job.Get(), process))
        return EChildEnd::Missing;
    writeEnd.Close();

    const EChildEnd end = Collect(pipe.Get(), limits, output, wait);
    if (end != EChildEnd::Finished)
        return end; // the job's end is the program's
    DWORD code = 0;
    const bool hasExited = WaitForSingleObject(process.Get(), kPatienceMilliseconds) == WAIT_OBJECT_0 &&
                           GetExitCodeProcess(process.Get(), &code) && code < kFirstCrashCode;
    return hasExited ? EChildEnd::Finished : EChildEnd::Died;
}

} // namespace gw
