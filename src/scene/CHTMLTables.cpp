#include "CHTMLTables.h"

#include "HTMLMarkup.h"

namespace gw {

namespace {

constexpr unsigned kBorder = 3;

} // namespace

void CHTMLTables::Begin(const CRTTI& record)
{
    End();
    m_kPage.AddLine(HTMLEnclosed(EHTMLElement::Heading, record.m_pcName));
    m_kPage.AddLine(HTMLRule());
    m_kPage.AddLine(HTMLTable(EHTMLEnd::Opening, kBorder) + kHTMLMembers);
    m_bOpen = true;
}

void CHTMLTables::End()
{
    if (m_bOpen)
        m_kPage.AddLine(HTMLTable(EHTMLEnd::Closing, kBorder));
    m_bOpen = false;
}

void CHTMLTables::Row(std::string_view label, std::string_view cell)
{
    m_kPage.AddLine(HTMLEnclosed(EHTMLElement::TableRow, HTMLEnclosed(EHTMLElement::HeaderCell, label) +
                                                             HTMLEnclosed(EHTMLElement::DataCell, cell)));
}

void CHTMLTables::AddRows(std::span<const CFieldRow> rows)
{
    for (const CFieldRow& row : rows)
    {
        Row(row.name, row.cell);
        m_kLinked.insert(m_kLinked.end(), row.linked.begin(), row.linked.end());
    }
}

} // namespace gw
