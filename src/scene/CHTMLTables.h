#pragma once

#include "CFieldRows.h"
#include "COrnHTMLPage.h"
#include "CRTTI.h"

#include <span>
#include <string>
#include <string_view>
#include <vector>

namespace gw {

/// Writes the tables of one object to a page, class by class, and collects the objects that they link to.
/// Each class adds its table in CObject::DumpTable.
class CHTMLTables
{
public:
    explicit CHTMLTables(COrnHTMLPage& page) : page_(page) {}

    /// Starts a class: its heading and its table, which the next Begin or End closes.
    void Begin(const CRTTI& record);
    void End();
    /// Adds a row. Label and cell are markup.
    void Row(std::string_view label, std::string_view cell);
    /// Requests a page for an object that a row links to.
    void Follow(CObject& object) { m_kLinked.push_back(&object); }

    /// Adds a table of the fields that a class adds to its base.
    template <class Class, class Base>
    void OwnFields(Class& object)
    {
        CFieldRows inherited;
        object.Base::Fields(inherited);
        CFieldRows rows;
        object.Class::Fields(rows);
        Begin(Class::ms_kRTTI);
        AddRows(rows.Rows().subspan(inherited.Rows().size()));
    }

    /// Returns the objects that need a page, in link order, possibly with duplicates.
    const std::vector<CObject*>& Linked() const { return m_kLinked; }

private:
    void AddRows(std::span<const FieldRow> rows);

    COrnHTMLPage& page_;
    std::vector<CObject*> m_kLinked;
    bool m_bOpen = false;
};

} // namespace gw
