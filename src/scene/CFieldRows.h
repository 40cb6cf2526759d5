#pragma once

#include "CFieldArchive.h"

#include <span>
#include <string>
#include <vector>

namespace gw {

/// One stored field as a table row.
struct FieldRow
{
    std::string name;
    std::string cell;             ///< markup
    std::vector<CObject*> linked; ///< the objects that the cell links to
};

/// Makes one row per field. Long blocks and lists are shortened and show their length; every link is shown.
class CFieldRows : public CFieldArchive
{
public:
    CFieldRows() : CFieldArchive(false, kNewestVersion) {}

    std::span<const FieldRow> Rows() const { return m_kRows; }

    void Text(const char* name, CText& text) override;
    bool Presence(const char* name, bool present) override;
    size_t Count(const char* name, size_t count, size_t leastBytes) override;

protected:
    void Values(const char* name, EFieldKind kind, void* values, size_t count) override;
    void Slot(const char* name, const CLinkSlot& slot) override;
    void BeginArray(const char* name, EListKind kind) override;
    void EndArray() override;
    void BeginElement() override;

private:
    void Show(const char* name, const std::string& text);

    std::vector<FieldRow> m_kRows;
    size_t m_uiArrays = 0;  // nesting depth of arrays at the current field
    size_t m_uiRecords = 0; // so far, in the outermost array
    size_t m_uiCount = 0;   // the last count
};

} // namespace gw
