#include "CHTMLTables.h"

#include "HTMLMarkup.h"

namespace gw {

namespace {

constexpr unsigned kBorder = 3;

} // namespace

void CHTMLTables::Begin(const CRTTI& record)
{
    End();
    page_.AddLine(HTMLEnclosed(EHTMLElement::Heading, record.m_pcName));
    page_.AddLine(HTMLRule());
    page_.AddLine(HTMLTable(EHTMLEnd::Opening, kBorder) + kHTMLMembers);
    m_bOpen = true;
}

void CHTMLTables::End()
{
    if (m_bOpen)
        page_.AddLine(HTMLTable(EHTMLEnd::Closing, kBorder));
    m_bOpen = false;
}

void CHTMLTables::Row(std::string_view label, std::string_view cell)
{
    page_.AddLine(HTMLEnclosed(EHTMLElement::TableRow, HTMLEnclosed(EHTMLElement::HeaderCell, label) +
                                                           HTMLEnclosed(EHTMLElement::DataCell, cell)));
}

void CHTMLTables::AddRows(std::span<const FieldRow> rows)
{
    for (const FieldRow& row : rows)
    {
        Row(row.name, row.cell);
        m_kLinked.insert(m_kLinked.end(), row.linked.begin(), row.linked.end());
    }
}

} // namespace gw
