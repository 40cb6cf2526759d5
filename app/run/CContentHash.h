#pragma once

#include <cstdint>
#include <memory>
#include <string>
#include <string_view>

struct XXH3_state_s;

namespace gw {

/// A 128-bit hash (XXH3) of several texts and files in their order; which bytes belong to which counts too.
/// It tells changes, and is no defence against somebody who forges a file.
class CContentHash
{
public:
    CContentHash();
    ~CContentHash();
    CContentHash(const CContentHash&) = delete;
    CContentHash& operator=(const CContentHash&) = delete;

    CContentHash& AddText(std::string_view text);
    /// The bytes of a file. One that cannot be read counts as such, and not as an empty one.
    CContentHash& AddFile(const std::string& path);
    /// 32 hexadecimal digits.
    std::string Digits() const;

private:
    void AddPart(char kind, std::string_view bytes);

    struct Free
    {
        void operator()(XXH3_state_s* state) const;
    };
    std::unique_ptr<XXH3_state_s, Free> m_spState;
};

/// The hash of a file alone, or empty where it cannot be read.
std::string FileDigits(const std::string& path);

} // namespace gw
