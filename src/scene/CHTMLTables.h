#pragma once

#include "CFieldRows.h"
#include "COrnHTMLPage.h"
#include "CRTTI.h"

#include <span>
#include <string>
#include <string_view>
#include <vector>

namespace gw {

/// Puts the tables of one object on a page, class by class, and collects the objects that their anchors lead
/// to. A class says in CObject::DumpTable what its table has.
class CHTMLTables
{
public:
    explicit CHTMLTables(COrnHTMLPage& page) : page_(page) {}

    /// The heading of a class and its table, closed by the next one or by End.
    void Begin(const CRTTI& record);
    void End();
    /// Label and cell are markup.
    void Row(std::string_view label, std::string_view cell);
    /// Gives an object a page, for one that a row has an anchor to.
    void Follow(CObject& object) { m_kLinked.push_back(&object); }

    /// A table of all that a class adds to the stored fields of its base.
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

    /// Who is to have a page, in the order of the anchors; an object may stand there twice.
    const std::vector<CObject*>& Linked() const { return m_kLinked; }

private:
    void AddRows(std::span<const FieldRow> rows);

    COrnHTMLPage& page_;
    std::vector<CObject*> m_kLinked;
    bool m_bOpen = false;
};

} // namespace gw
