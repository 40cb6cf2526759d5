// The program's side of a worker process. The system cannot copy a process, so the program is started again
// with an argument that names the handles it inherits. A worker writes to files rather than pipes, so it can
// never block on a full pipe, and its last output survives its death.

#include "CWorkerChild.h"

#include "CWorkerStart.h"
#include "Paths.h"
#include "PrivateNames.h"

#include <array>
#include <cstring>
#include <string_view>
#include <vector>

namespace gw {

namespace {

constexpr DWORD kPatience = 5'000; // milliseconds to wait for a process that was asked to end

// Ends its processes when the program ends, however it does.
HANDLE JobOfWorkers()
{
    static const HANDLE job = [] {
        const HANDLE made = CreateJobObjectW(nullptr, nullptr);
        JOBOBJECT_EXTENDED_LIMIT_INFORMATION limits = {};
        limits.BasicLimitInformation.LimitFlags = JOB_OBJECT_LIMIT_KILL_ON_JOB_CLOSE;
        SetInformationJobObject(made, JobObjectExtendedLimitInformation, &limits, sizeof limits);
        return made;
    }();
    return job;
}

// Every worker signals it after a reply.
HANDLE ReplyEvent()
{
    static const HANDLE event = CreateEventW(nullptr, FALSE, FALSE, nullptr);
    return event;
}

// A copy of a handle that a started process may inherit; the process closes it by its end, and this one at
// once.
class CInherited
{
public:
    CInherited(HANDLE handle, DWORD access)
    {
        const HANDLE self = GetCurrentProcess();
        const DWORD options = access ? 0 : DUPLICATE_SAME_ACCESS;
        DuplicateHandle(self, handle, self, m_kCopy.Place(), access, TRUE, options);
    }
    HANDLE Get() const { return m_kCopy.Get(); }

private:
    CHandle m_kCopy;
};

// Creates a file that is gone when its last handle is closed. It stays in memory unless that is short.
// Returns null if that fails.
HANDLE CreateMemory()
{
    const std::string path = PrivateName(TemporaryFolder(), ".tmp");
    const HANDLE file =
        CreateFileW(WidePath(path).c_str(), GENERIC_READ | GENERIC_WRITE | DELETE, kShareAll, nullptr,
                    CREATE_NEW, FILE_ATTRIBUTE_TEMPORARY | FILE_FLAG_DELETE_ON_CLOSE, nullptr);
    return file == INVALID_HANDLE_VALUE ? nullptr : file;
}

// Removes and returns the text. The worker, which may only append, goes on at the start.
std::string TakeText(HANDLE file)
{
    LARGE_INTEGER size = {};
    std::string text;
    if (!GetFileSizeEx(file, &size) || size.QuadPart == 0)
        return text;
    text.resize(static_cast<size_t>(size.QuadPart));
    DWORD count = 0;
    SetFilePointer(file, 0, nullptr, FILE_BEGIN);
    if (!ReadFile(file, text.data(), static_cast<DWORD>(text.size()), &count, nullptr))
        count = 0;
    text.resize(count);
    SetFilePointer(file, 0, nullptr, FILE_BEGIN);
    if (!SetEndOfFile(file))
        text.clear(); // otherwise it would be reported twice
    return text;
}

HANDLE MemoryOf(std::string_view text)
{
    const auto size = static_cast<DWORD>(text.size() + 1);
    const HANDLE memory = CreateFileMappingW(INVALID_HANDLE_VALUE, nullptr, PAGE_READWRITE, 0, size, nullptr);
    void* const view = memory ? MapViewOfFile(memory, FILE_MAP_WRITE, 0, 0, 0) : nullptr;
    if (view)
        std::memcpy(view, text.data(), text.size());
    UnmapViewOfFile(view);
    return memory;
}

std::wstring ProgramPath()
{
    std::wstring path(32'768, L'\0'); // no path is longer
    path.resize(GetModuleFileNameW(nullptr, path.data(), static_cast<DWORD>(path.size())));
    return path;
}

// The attributes of a new process: the only handles that it inherits.
class CAttributes
{
public:
    explicit CAttributes(std::span<HANDLE> handles)
    {
        SIZE_T byteCount = 0;
        InitializeProcThreadAttributeList(nullptr, 1, 0, &byteCount);
        m_kBytes.resize(byteCount);
        m_bGood = InitializeProcThreadAttributeList(Get(), 1, 0, &byteCount) != 0 &&
                  UpdateProcThreadAttribute(Get(), 0, PROC_THREAD_ATTRIBUTE_HANDLE_LIST, handles.data(),
                                            handles.size_bytes(), nullptr, nullptr) != 0;
    }
    ~CAttributes() { DeleteProcThreadAttributeList(Get()); }
    CAttributes(const CAttributes&) = delete;
    CAttributes& operator=(const CAttributes&) = delete;

    bool IsGood() const { return m_bGood; }
    LPPROC_THREAD_ATTRIBUTE_LIST Get()
    {
        return reinterpret_cast<LPPROC_THREAD_ATTRIBUTE_LIST>(m_kBytes.data());
    }

private:
    std::vector<char> m_kBytes;
    bool m_bGood = false;
};

constexpr struct
{
    DWORD code;
    const char* words;
} kCauses[] = {
    {0xc0000005, "access violation"   },
    {0xc00000fd, "stack overflow"     },
    {0xc0000374, "heap corruption"    },
    {0xc0000094, "division by zero"   },
    {0xc000001d, "illegal instruction"},
    {0xc0000409, "failed check"       },
};

std::string CauseOf(DWORD code)
{
    for (const auto& row : kCauses)
    {
        if (row.code == code)
            return row.words;
    }
    return "exit code " + std::to_string(code);
}

} // namespace

std::unique_ptr<CWorkerChild> CWorkerChild::Start(CJobHandler& handler, ECommit commit,
                                                  std::span<CWorkerChild* const>)
{
    std::unique_ptr<CWorkerChild> child(new CWorkerChild);
    CWorkerStart start;
    const std::string task = handler.Description();
    const CHandle memory(MemoryOf(task));
    start.handles[CWorkerStart::Task] = memory.Get();
    start.taskBytes = task.size();
    start.commit = commit;
    return memory && child->Open(start) ? std::move(child) : nullptr;
}

// The worker's ends are closed here: a pipe must break when the worker ends.
bool CWorkerChild::Open(CWorkerStart& start)
{
    CHandle orders;
    CHandle replies;
    *m_kOutput.Place() = CreateMemory();
    *m_kWords.Place() = CreateMemory();
    *m_kRecord.Place() = CreateMemory();
    if (!m_kOutput || !m_kWords || !m_kRecord || !CreatePipe(orders.Place(), m_kOrders.Place(), nullptr, 0) ||
        !CreatePipe(m_kReplies.Place(), replies.Place(), nullptr, 0))
        return false;
    start.handles[CWorkerStart::Orders] = orders.Get();
    start.handles[CWorkerStart::Replies] = replies.Get();
    start.handles[CWorkerStart::Event] = ReplyEvent();
    start.handles[CWorkerStart::Output] = m_kOutput.Get();
    start.handles[CWorkerStart::Words] = m_kWords.Get();
    start.handles[CWorkerStart::Record] = m_kRecord.Get();
    return StartProcess(start);
}

bool CWorkerChild::StartProcess(const CWorkerStart& start)
{
    constexpr DWORD kAppending = FILE_APPEND_DATA | SYNCHRONIZE;
    constexpr DWORD kAccess[CWorkerStart::Count] = {0, 0, 0, kAppending, kAppending, kAppending, 0};
    std::array<std::unique_ptr<CInherited>, CWorkerStart::Count> inherited;
    std::vector<HANDLE> handles;
    CWorkerStart copies = start;
    for (size_t i = 0; i < inherited.size(); ++i)
    {
        inherited[i] = std::make_unique<CInherited>(start.handles[i], kAccess[i]);
        copies.handles[i] = handles.emplace_back(inherited[i]->Get());
    }
    const CHandle nothing(CreateFileW(L"NUL", GENERIC_READ | GENERIC_WRITE,
                                      FILE_SHARE_READ | FILE_SHARE_WRITE, nullptr, OPEN_EXISTING, 0,
                                      nullptr));
    const CInherited standard(nothing.Get(), 0);
    handles.push_back(standard.Get());

    CAttributes attributes(handles);
    STARTUPINFOEXW startup = {};
    startup.StartupInfo.cb = sizeof startup;
    startup.StartupInfo.dwFlags = STARTF_USESTDHANDLES;
    startup.StartupInfo.hStdInput = standard.Get();
    startup.StartupInfo.hStdOutput = standard.Get();
    startup.StartupInfo.hStdError = standard.Get();
    startup.lpAttributeList = attributes.Get();
    const std::wstring program = ProgramPath();
    std::wstring command =
        L"\"" + program + L"\" " + WideText(kWorkerArgument) + L' ' + WideText(copies.Text());
    // In a group of its own, Ctrl-C does not reach it before it can ignore that. It starts when it is in the
    // job.
    constexpr DWORD kFlags = CREATE_SUSPENDED | CREATE_NEW_PROCESS_GROUP | EXTENDED_STARTUPINFO_PRESENT;
    PROCESS_INFORMATION process = {};
    if (!attributes.IsGood() || !CreateProcessW(program.c_str(), command.data(), nullptr, nullptr, TRUE,
                                                kFlags, nullptr, nullptr, &startup.StartupInfo, &process))
        return false;
    *m_kProcess.Place() = process.hProcess;
    const CHandle thread(process.hThread);
    AssignProcessToJobObject(JobOfWorkers(), process.hProcess);
    ResumeThread(process.hThread);
    return true;
}

CWorkerChild::~CWorkerChild()
{
    Close();
    if (m_kProcess && WaitForSingleObject(m_kProcess.Get(), kPatience) != WAIT_OBJECT_0)
        Kill();
}

// A worker that has ended without a reply shows at the latest after the time limit.
void CWorkerChild::WaitForAny(std::span<CWorkerChild* const>, std::chrono::milliseconds limit)
{
    WaitForSingleObject(ReplyEvent(), static_cast<DWORD>(limit.count()));
}

void CWorkerChild::Send(const WorkerOrder& order)
{
    DWORD count = 0;
    WriteFile(m_kOrders.Get(), &order, sizeof order, &count, nullptr);
}

CWorkerChild::EReceived CWorkerChild::Receive(WorkerReply& reply)
{
    DWORD available = 0;
    if (!PeekNamedPipe(m_kReplies.Get(), nullptr, 0, nullptr, &available, nullptr))
        return EReceived::End;
    if (available < sizeof reply)
        return EReceived::Nothing;
    DWORD count = 0;
    const bool good =
        ReadFile(m_kReplies.Get(), &reply, sizeof reply, &count, nullptr) != 0 && count == sizeof reply;
    return good ? EReceived::Reply : EReceived::End;
}

void CWorkerChild::Kill()
{
    TerminateProcess(m_kProcess.Get(), 1);
    WaitForSingleObject(m_kProcess.Get(), kPatience); // its files are closed only then
}

std::string CWorkerChild::Wait()
{
    DWORD code = 0;
    WaitForSingleObject(m_kProcess.Get(), INFINITE);
    GetExitCodeProcess(m_kProcess.Get(), &code);
    m_kProcess.Close();
    return CauseOf(code);
}

void CWorkerChild::Close()
{
    m_kOrders.Close();
}

std::string CWorkerChild::TakeOutput()
{
    return TakeText(m_kOutput.Get());
}

std::string CWorkerChild::TakeWords()
{
    return TakeText(m_kWords.Get());
}

std::string CWorkerChild::TakeRecord()
{
    return TakeText(m_kRecord.Get());
}

} // namespace gw
