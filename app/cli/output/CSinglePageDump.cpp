// The pages of a dump are made to be files that link to each other. Here, their text is taken as it is made,
// and the links are changed. Names of objects cannot contain what is searched for, because quotes and "<" are
// escaped in them.

#include "CSinglePageDump.h"

#include "CSafeFile.h"
#include "HTMLMarkup.h"
#include "TreeViewScript.h"

#include <algorithm>
#include <string_view>

namespace gw {

namespace {

constexpr std::string_view kExtension = ".htm";

// The start of a link to an object's page, what replaces it, and the same for its end.
struct LinkRow
{
    std::string_view start;
    std::string_view newStart;
    std::string_view end;
    std::string_view newEnd;
};
constexpr LinkRow kTreeLink{"\", \"OrnHTML", "\", \"#OrnHTML", ".htm target=mainFrame\"", " target=_self\""};
constexpr LinkRow kPageLink{R"(HREF=".\OrnHTML)", R"(HREF="#OrnHTML)", ".htm\"", "\""};

std::string WithLinks(std::string_view text, const LinkRow& row)
{
    std::string changed;
    for (size_t at = text.find(row.start); at != text.npos; at = text.find(row.start))
    {
        changed.append(text.substr(0, at)).append(row.newStart);
        text.remove_prefix(at + row.start.size());
        const size_t end = text.find(row.end);
        if (end == text.npos)
            break;
        changed.append(text.substr(0, end)).append(row.newEnd);
        text.remove_prefix(end + row.end.size());
    }
    return changed.append(text);
}

// Returns the script that a tree page runs.
std::string_view ScriptOf(std::string_view page)
{
    constexpr std::string_view kStart = "<script language=\"JavaScript\">";
    constexpr std::string_view kEnd = "</script>\n";
    page.remove_prefix(std::min(page.find(kStart), page.size()));
    return page.substr(0, page.find(kEnd) + kEnd.size());
}

} // namespace

bool CSinglePageDump::Write(const COrnHTMLPage& page, const std::string& fileName)
{
    const std::string text = page.Text();
    if (fileName.starts_with("TreeView"))
        m_kTrees += WithLinks(ScriptOf(text), kTreeLink);
    if (!fileName.starts_with("OrnHTML") || text.empty())
        return !text.empty();
    std::string_view body = text;
    body.remove_prefix(body.starts_with(kHTMLCodePage) ? sizeof kHTMLCodePage : 0); // and the line feed
    m_kSections.Write("<div id=\"" + fileName.substr(0, fileName.size() - kExtension.size()) + "\">\n" +
                      WithLinks(body, kPageLink) + "</div>\n");
    return true;
}

bool CSinglePageDump::WriteTo(const std::string& path)
{
    const std::string head = std::string("<!DOCTYPE html>\n<html>\n<head>\n") + kHTMLCodePage + "\n<title>" +
                             kHTMLContents + "</title>\n<script>\n" + std::string(kTreeViewScript) +
                             "</script>\n</head>\n<body>\n";
    CSafeFile file;
    return file.Open(path) && file.Write(head) && file.Write(m_kTrees) && m_kSections.CopyTo(file) &&
           file.Write(std::string_view("</body>\n</html>\n")) && file.Commit();
}

} // namespace gw
