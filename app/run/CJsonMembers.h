#pragma once

#include "Finding.h"

#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

namespace gw {

/// Our own JSON lines have four levels (values in notices in a list in a line).
inline constexpr size_t kJsonDepthLimit = 16;

/// The members of a JSON object, or the elements of an array (with empty keys). Nested objects and arrays
/// stay text, to be parsed in turn. No tree is built, because destroying a tree of the JSON library allocates
/// memory, and ends the program if that fails.
class CJsonMembers
{
public:
    enum class EKind : uint8_t
    {
        Null,
        Bool,
        Integer, ///< from -2^63 to 2^63 - 1
        Number,  ///< any other number
        Text,
        Nested, ///< an object or array as compact JSON in `text`
    };
    struct Member
    {
        std::string key = {};
        EKind kind = EKind::Null;
        bool flag = false;     ///< for Bool
        int64_t integer = 0;   ///< for Integer
        double number = 0.0;   ///< for Integer or Number
        std::string text = {}; ///< for Text or Nested
    };

    /// Parses a whole text. Returns UnexpectedLine if it is not JSON, TooDeep if it is nested deeper than
    /// kJsonDepthLimit. The list of members is then empty.
    EFailure Read(std::string_view text);

    /// Returns false for an array.
    bool IsObject() const { return m_bObject; }
    const std::vector<Member>& Members() const { return m_kMembers; }
    /// Returns the last member with a key, or null.
    const Member* Find(std::string_view key) const;
    /// Stores the value of a text member. Returns false and leaves `text` unchanged for any other.
    bool TakeText(std::string_view key, std::string& text) const;
    /// Stores the value of an integer member from 0 to 2^63 - 1, like TakeText.
    bool TakeCount(std::string_view key, uint64_t& count) const;

private:
    bool m_bObject = false;
    std::vector<Member> m_kMembers;
};

} // namespace gw
