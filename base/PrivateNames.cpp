#include "PrivateNames.h"

#include "Paths.h"

#include <cerrno>
#include <charconv>
#include <cstdint>
#include <cstdio>
#include <random>

#include <csignal>
#include <unistd.h>

namespace gw {

namespace {

constexpr std::string_view kPrefix = ".gaitwright-";
constexpr size_t kDigits = 8;
constexpr size_t kPartBytes = kDigits + 1; // with the dash or the end behind it

// Names of machines are short; two of one number are one machine here, which costs no more than a leftover or
// a conversion that has to be made again.
uint32_t MachineNumber()
{
    char name[256] = {};
    gethostname(name, sizeof name - 1);
    uint32_t number = 2166136261u; // FNV-1a
    for (const char* c = name; *c; ++c)
        number = (number ^ static_cast<unsigned char>(*c)) * 16777619u;
    return number;
}

// A part of a private name: machine, program or the random one.
bool ReadPart(std::string_view name, size_t part, uint32_t& number)
{
    const size_t begin = kPrefix.size() + part * kPartBytes;
    if (name.size() < begin + kDigits)
        return false;
    const char* const digits = name.data() + begin;
    const auto [end, error] = std::from_chars(digits, digits + kDigits, number, 16);
    return error == std::errc() && end == digits + kDigits;
}

bool IsGone(uint32_t program)
{
    return kill(static_cast<pid_t>(program), 0) != 0 && errno == ESRCH;
}

bool IsLeftover(std::string_view name)
{
    uint32_t machine = 0;
    uint32_t program = 0;
    return IsPrivateName(name) && ReadPart(name, 0, machine) && ReadPart(name, 1, program) &&
           machine == MachineNumber() && program != 0 && IsGone(program);
}

} // namespace

std::string PrivateName(const std::string& folder, std::string_view extension)
{
    std::random_device random;
    char parts[3 * kPartBytes + 1];
    std::snprintf(parts, sizeof parts, "%08x-%08x-%08x", MachineNumber(), static_cast<uint32_t>(getpid()),
                  random());
    return folder + std::string(kPrefix) + parts + std::string(extension);
}

bool IsPrivateName(std::string_view name)
{
    return name.starts_with(kPrefix);
}

void RemoveLeftovers(const std::string& folder)
{
    for (const std::string& name : NamesInFolder(folder))
    {
        if (IsLeftover(name))
            unlink((WithSeparator(folder) + name).c_str());
    }
}

} // namespace gw
