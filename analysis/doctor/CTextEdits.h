#pragma once

#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

namespace gw {

class CSafeFile;

/// Replacements in a text, which itself stays as it is. They may come in any order and must not
/// overlap; of two at one place the one that came first is done first. Beyond kMost of them no more are
/// taken: such a text is no motion, and mending it must not take more memory than it is worth.
class CTextEdits
{
public:
    static constexpr size_t kMost = size_t{1} << 19;

    /// Puts `instead` in the place of `length` bytes from `begin` on.
    void Replace(size_t begin, size_t length, std::string_view instead);

    /// Writes the text as it is with all edits done. False when the file takes it not.
    bool Write(std::string_view text, CSafeFile& file);

private:
    struct Edit
    {
        size_t begin;
        size_t length;
        size_t firstInstead; // in m_kInstead
        size_t insteadLength;
    };

    void Add(size_t begin, size_t length, std::string_view instead);

    std::vector<Edit> m_kEdits;
    std::string m_kInstead; // the new texts, one behind the other
};

} // namespace gw
