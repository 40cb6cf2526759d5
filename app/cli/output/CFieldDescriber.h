#pragma once

#include "CFieldArchive.h"

#include <cstddef>
#include <cstdint>
#include <map>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

namespace gw {

class CJsonWriter;

/// The numbers that a report uses for the objects of a scene.
using CObjectNumbers = std::unordered_map<const CObject*, size_t>;

/// Which of an object's fields are described.
enum class EDescribe : uint8_t
{
    /// references to other objects, as their numbers; null for no object and for objects outside the scene
    Links,
    Fields, ///< everything else
};

/// Writes an object's fields as members of a JSON object, by name and in file order: vectors, quaternions (w
/// x y z) and matrices as arrays of numbers, byte blocks as hex. Links inside a list of records are written
/// with their record.
class CFieldDescriber : public CFieldArchive
{
public:
    CFieldDescriber(EDescribe what, CJsonWriter& json, const CObjectNumbers& numbers)
        : CFieldArchive(false, kNewestVersion), m_eWhat(what), json_(json), numbers_(numbers)
    {
    }
    ~CFieldDescriber() override { TakeCount({}); }

    void Text(const char* name, CText& text) override;
    bool Presence(const char* name, bool present) override;
    size_t Count(const char* name, size_t count, size_t leastBytes) override;

protected:
    void Values(const char* name, EFieldKind kind, void* values, size_t count) override;
    void Slot(const char* name, const CLinkSlot& slot) override;
    void BeginArray(const char* name, EListKind kind) override;
    void EndArray() override;
    void BeginElement() override;
    void EndElement() override;

private:
    // A count that belongs to the next field if that has the same name, and is a field by itself otherwise.
    struct PendingCount
    {
        std::string_view name; ///< empty if no count is pending
        size_t count = 0;
    };

    bool IsTold(EDescribe what) const { return m_kNest.empty() ? what == m_eWhat : m_bArrayIsTold; }
    PendingCount TakeCount(std::string_view nextName);
    void Key(std::string_view name);

    EDescribe m_eWhat;
    CJsonWriter& json_;
    const CObjectNumbers& numbers_;
    PendingCount m_kCount;
    std::vector<bool> m_kNest; ///< arrays (true) and elements (false) around the current field
    bool m_bArrayIsTold = false;
    std::map<std::string, int, std::less<>>
        m_kSeen; ///< members so far, because a list can contain two fields with the same name
};

} // namespace gw
