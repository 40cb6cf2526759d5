// The pages of a dump link to each other, and any object can link to any other. So pages are not written
// recursively: an object that a page links to joins a queue, once, and the dump ends when the queue is empty.

#include "CHTMLDump.h"

#include "CHTMLTables.h"
#include "CNode.h"
#include "HTMLMarkup.h"
#include "HTMLText.h"

#include <utility>

namespace gw {

namespace {

// Returns the name of a node in the script.
std::string ScriptName(const CObject& object)
{
    return "Node" + HTMLUnsigned(object.GetID());
}

std::string FolderCall(const CObject& object)
{
    return "gFld(\"" + HTMLScriptText(object.NameView()) + "\", \"" +
           GetHTMLFileName(object, EHTMLPath::Bare) + " target=mainFrame\")";
}

void AddLines(COrnHTMLPage& page, std::initializer_list<const char*> lines)
{
    for (const char* line : lines)
        page.AddLine(line);
}

COrnHTMLWriter IndexPage(const CObject& root, const std::string& treeName)
{
    COrnHTMLWriter page;
    AddLines(page, {"<html>", "<head>", "<title>TKOrrin TreeView</title>", kHTMLCodePage, "</head>",
                    R"(<frameset cols="300,*" frameborder="YES" border="1" framespacing="0" rows="*">)"});
    page.AddFormat(R"(<frame name="leftFrame" scrolling="auto" src="%s">)", treeName.c_str());
    page.AddFormat(R"(<frame name="mainFrame" src="%s">)", GetHTMLFileName(root, EHTMLPath::Bare).c_str());
    AddLines(page, {"</frameset>", "<noframes>", R"(<body bgcolor="#FFFFFF">)", "</body>", "</noframes>",
                    "</html>"});
    return page;
}

// Every object page names its code page, because it can be opened on its own.
COrnHTMLWriter ObjectPage()
{
    COrnHTMLWriter page;
    page.AddLine(kHTMLCodePage);
    return page;
}

} // namespace

thread_local CHTMLDump* CHTMLDump::ms_pkRunning = nullptr;

// Breadth-first. Repeated nodes are listed but not expanded, so the tree is no larger than the graph's number
// of links.
std::vector<CHTMLDump::TreeEntry> CHTMLDump::TreeOf(CObject& root)
{
    std::unordered_set<const CObject*> inTree{&root};
    std::vector<TreeEntry> entries{
        {&root, nullptr, true}
    };
    for (size_t i = 0; i < entries.size(); ++i)
    {
        CNode* const node = entries[i].isFirst ? RecordCast<CNode>(entries[i].object) : nullptr;
        if (!node || (!m_kExpanded.insert(node).second && m_uiEntries >= kEntryLimit))
            continue;
        for (size_t slot = 0; slot < node->GetChildCount(); ++slot)
        {
            CNode* const child = RecordCast<CNode>(node->ChildAt(slot));
            if (!child)
                continue;
            entries.push_back({child, node, inTree.insert(child).second});
            ++m_uiEntries;
        }
    }
    return entries;
}

// Only the first entry of a node has a name in the script, because its children are added there.
std::string CHTMLDump::TreeScript(const std::vector<TreeEntry>& entries)
{
    std::string script = "\n";
    for (const TreeEntry& entry : entries)
    {
        if (entry.isFirst)
            script += ScriptName(*entry.object) + " = ";
        if (entry.parent)
            script += "insFld(" + ScriptName(*entry.parent) + ", " + FolderCall(*entry.object) + ");\n";
        else
            script += FolderCall(*entry.object) + ";\n";
    }
    return script + "initializeDocument(" + ScriptName(*entries.front().object) + ")\n";
}

COrnHTMLWriter CHTMLDump::TreePage(const std::vector<TreeEntry>& entries)
{
    COrnHTMLWriter page;
    AddLines(page, {"<html>", "<head>"});
    page.AddFormat("<title>%s</title>", kHTMLContents);
    AddLines(page, {kHTMLCodePage, R"(<script language="JavaScript" src="TreeView.js">)", "</script>",
                    "</head>", R"(<body bgcolor="#FFFFFF">)", R"(<script language="JavaScript">)"});
    page.AddLine(HTMLEnclosed(EHTMLElement::Comment, TreeScript(entries)));
    AddLines(page, {"</script>", "</body>", "</html>"});
    return page;
}

bool CHTMLDump::Write(const COrnHTMLPage& page, const std::string& fileName)
{
    return page.SaveAs(m_kFolder + fileName);
}

void CHTMLDump::Save(const COrnHTMLPage& page, const std::string& fileName)
{
    ++m_uiPages;
    if (Write(page, fileName))
        return;
    if (m_uiFailed++ == 0)
        m_kFirstFailed = fileName;
}

void CHTMLDump::AddTables(COrnHTMLWriter& page, CObject& object)
{
    CHTMLTables tables(page);
    object.DumpTable(tables);
    tables.End();
    for (CObject* linked : tables.Linked())
    {
        if (m_kKnown.insert(linked).second)
            m_kWaiting.push_back(linked);
    }
}

void CHTMLDump::AddObject(const std::string& folder, COrnHTMLWriter& page, CObject& object)
{
    if (ms_pkRunning)
        return ms_pkRunning->AddTables(page, object);
    CHTMLDump dump(folder);
    dump.m_kKnown.insert(&object);
    dump.AddTables(page, object);
    dump.SaveWaiting();
}

void CHTMLDump::SavePageOf(CObject& object)
{
    struct Running
    {
        explicit Running(CHTMLDump& dump) : outer(std::exchange(ms_pkRunning, &dump)) {}
        ~Running() { ms_pkRunning = outer; }
        CHTMLDump* outer;
    };
    COrnHTMLWriter page = ObjectPage();
    {
        const Running running(*this);
        object.DumpHTML(m_kFolder, page);
    }
    Save(page, GetHTMLFileName(object, EHTMLPath::Bare));
}

void CHTMLDump::SaveWaiting()
{
    while (!m_kWaiting.empty())
    {
        CObject& next = *m_kWaiting.back();
        m_kWaiting.pop_back();
        SavePageOf(next);
    }
}

std::string CHTMLDump::WriteSite(CObject& root)
{
    const std::string ending = (++m_uiSites == 1 ? "" : std::to_string(m_uiSites)) + ".htm";
    Save(IndexPage(root, "TreeView" + ending), "Index" + ending);
    Save(TreePage(TreeOf(root)), "TreeView" + ending);
    if (m_kKnown.insert(&root).second)
        m_kWaiting.push_back(&root);
    SaveWaiting();
    return "Index" + ending;
}

} // namespace gw
