#include "CContentHash.h"

#include "CMappedFile.h"

#include <cstdio>
#include <new>
#include <xxhash.h>

namespace gw {

CContentHash::CContentHash() : m_spState(XXH3_createState())
{
    if (!m_spState)
        throw std::bad_alloc();
    XXH3_128bits_reset(m_spState.get());
}

CContentHash::~CContentHash() = default;

void CContentHash::Free::operator()(XXH3_state_s* state) const
{
    XXH3_freeState(state);
}

// Kind and length before the bytes distinguish "ab", "c" from "a", "bc".
void CContentHash::AddPart(char kind, std::string_view bytes)
{
    const std::string head = std::to_string(bytes.size()) + kind;
    XXH3_128bits_update(m_spState.get(), head.data(), head.size());
    XXH3_128bits_update(m_spState.get(), bytes.data(), bytes.size());
}

CContentHash& CContentHash::AddText(std::string_view text)
{
    AddPart('t', text);
    return *this;
}

CContentHash& CContentHash::AddFile(const std::string& path)
{
    CMappedFile file;
    const bool isThere = file.Open(path) == EFailure::None;
    AddPart(isThere ? 'f' : 'n', file.Text());
    if (!file.IsWhole())
        AddPart('c', {}); // cannot occur for a complete file
    return *this;
}

std::string CContentHash::Digits() const
{
    const XXH128_hash_t hash = XXH3_128bits_digest(m_spState.get());
    char digits[33];
    std::snprintf(digits, sizeof digits, "%016llx%016llx", static_cast<unsigned long long>(hash.high64),
                  static_cast<unsigned long long>(hash.low64));
    return digits;
}

std::string FileDigits(const std::string& path)
{
    CMappedFile file;
    if (file.Open(path) != EFailure::None)
        return {};
    const std::string digits = CContentHash().AddText(file.Text()).Digits();
    return file.IsWhole() ? digits : std::string();
}

} // namespace gw
