#pragma once

#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

namespace gw {

class CSafeFile;

/// Replacements in a text, which itself stays as it is. They may come in any order and must not
/// overlap; of two at one place the one that came first is done first.
class CTextEdits
{
public:
    /// Puts `instead` in the place of `length` bytes from `begin` on.
    void Replace(size_t begin, size_t length, std::string_view instead);
    bool IsEmpty() const { return m_kEdits.empty(); }

    /// Writes the text as it is with all edits done. False when the file takes it not.
    bool Write(std::string_view text, CSafeFile& file);

private:
    // Small, since a hostile file asks for one on every few bytes.
    struct Edit
    {
        size_t begin;
        size_t length;
        size_t firstInstead; // in m_kInstead
        size_t insteadLength;
    };

    std::vector<Edit> m_kEdits;
    std::string m_kInstead; // the new texts, one behind the other
};

} // namespace gw
