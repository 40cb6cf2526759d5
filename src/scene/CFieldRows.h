#pragma once

#include "CFieldArchive.h"

#include <span>
#include <string>
#include <vector>

namespace gw {

/// One stored field as a row of a table.
struct FieldRow
{
    std::string name;
    std::string cell;             ///< markup
    std::vector<CObject*> linked; ///< what the cell has anchors to
};

/// Makes a row of every field. Of long blocks and lists the beginning is shown and their length told; every
/// link is shown.
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
    size_t m_uiArrays = 0;  // around the present place
    size_t m_uiRecords = 0; // so far, in the outermost array
    size_t m_uiCount = 0;   // the last one
};

} // namespace gw
