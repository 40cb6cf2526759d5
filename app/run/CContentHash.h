#pragma once

#include <cstdint>
#include <memory>
#include <string>
#include <string_view>

struct XXH3_state_s;

namespace gw {

/// A 128-bit hash (XXH3) of several texts and files in order, including the boundaries between them. It
/// detects changes but does not protect against forgery.
class CContentHash
{
public:
    CContentHash();
    ~CContentHash();
    CContentHash(const CContentHash&) = delete;
    CContentHash& operator=(const CContentHash&) = delete;

    CContentHash& AddText(std::string_view text);
    /// Adds the bytes of a file. An unreadable file differs from an empty one.
    CContentHash& AddFile(const std::string& path);
    /// Returns 32 hexadecimal digits.
    std::string Digits() const;

private:
    void AddPart(char kind, std::string_view bytes);

    struct Free
    {
        void operator()(XXH3_state_s* state) const;
    };
    std::unique_ptr<XXH3_state_s, Free> m_spState;
};

/// Returns the hash of one file, or empty if it cannot be read.
std::string FileDigits(const std::string& path);

} // namespace gw
