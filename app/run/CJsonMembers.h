#pragma once

#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

namespace gw {

/// Our own lines of JSON nest four levels (values in reports in a list in a line).
inline constexpr size_t kJsonDepthLimit = 16;

enum class EJsonFault : uint8_t
{
    None,
    NotJson,
    TooDeep, ///< nested deeper than kJsonDepthLimit
};

/// The members of a JSON object, or the elements of an array, whose keys are empty. Values that are objects
/// or arrays themselves stay text, to be read in turn. No tree is built: dropping a tree of the JSON library
/// takes memory, and ends the program if there is none.
class CJsonMembers
{
public:
    enum class EKind : uint8_t
    {
        Null,
        Bool,
        Integer, ///< from -2^63 to 2^63 - 1
        Number,  ///< any other
        Text,
        Nested, ///< an object or array, as compact JSON in `text`
    };
    struct Member
    {
        std::string key = {};
        EKind kind = EKind::Null;
        bool flag = false;     ///< of a Bool
        int64_t integer = 0;   ///< of an Integer
        double number = 0.0;   ///< of an Integer or a Number
        std::string text = {}; ///< of a Text or of Nested
    };

    /// Reads a whole text. If that fails, no members are kept.
    EJsonFault Read(std::string_view text);

    /// False for an array.
    bool IsObject() const { return m_bObject; }
    const std::vector<Member>& Members() const { return m_kMembers; }
    /// The last member with a key, or null.
    const Member* Find(std::string_view key) const;
    /// Takes a member that is a text. False, with `text` unchanged, for any other.
    bool TakeText(std::string_view key, std::string& text) const;
    /// Takes a member that is an integer from 0 to 2^63 - 1.
    bool TakeCount(std::string_view key, uint64_t& count) const;

private:
    bool m_bObject = false;
    std::vector<Member> m_kMembers;
};

} // namespace gw
