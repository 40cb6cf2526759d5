#include "CHTMLDump.h"

#include "CHTMLTables.h"
#include "CNode.h"
#include "HTMLMarkup.h"
#include "HTMLText.h"

#include <span>

namespace gw {

namespace {

// A node of the tree with the one above it, null at the root.
struct TreeEntry
{
    CObject* object;
    CObject* parent;
};

// Level by level. A node with several places stands at the first.
std::vector<TreeEntry> TreeOf(CObject& root, std::unordered_set<const CObject*>& inTree)
{
    std::vector<TreeEntry> entries{
        {&root, nullptr}
    };
    inTree.insert(&root);
    for (size_t i = 0; i < entries.size(); ++i)
    {
        CNode* const node = RecordCast<CNode>(entries[i].object);
        for (size_t slot = 0; node && slot < node->GetChildCount(); ++slot)
        {
            CNode* const child = RecordCast<CNode>(node->ChildAt(slot));
            if (child && inTree.insert(child).second)
                entries.push_back({child, node});
        }
    }
    return entries;
}

// What the script calls a node.
std::string ScriptName(const CObject& object)
{
    return "Node" + HTMLUnsigned(object.GetID());
}

std::string FolderCall(const CObject& object)
{
    return "gFld(\"" + HTMLScriptText(object.NameView()) + "\", \"" +
           GetHTMLFileName(object, EHTMLPath::Bare) + " target=mainFrame\")";
}

std::string TreeScript(std::span<const TreeEntry> entries)
{
    std::string script = "\n";
    for (const TreeEntry& entry : entries)
    {
        script += ScriptName(*entry.object) + " = ";
        if (entry.parent)
            script += "insFld(" + ScriptName(*entry.parent) + ", " + FolderCall(*entry.object) + ");\n";
        else
            script += FolderCall(*entry.object) + ";\n";
    }
    return script + "initializeDocument(" + ScriptName(*entries.front().object) + ")\n";
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

COrnHTMLWriter TreePage(std::span<const TreeEntry> entries)
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

// Every page of an object tells its code page, for it may be opened by itself.
COrnHTMLWriter ObjectPage()
{
    COrnHTMLWriter page;
    page.AddLine(kHTMLCodePage);
    return page;
}

} // namespace

void CHTMLDump::Save(const COrnHTMLPage& page, const std::string& fileName)
{
    ++m_uiPages;
    if (!page.SaveAs(m_kFolder + fileName))
        ++m_uiFailed;
}

void CHTMLDump::AddTables(COrnHTMLPage& page, CObject& object)
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

void CHTMLDump::Fill(COrnHTMLPage& page, CObject& object)
{
    m_kKnown.insert(&object);
    AddTables(page, object);
    while (!m_kWaiting.empty())
    {
        CObject& next = *m_kWaiting.back();
        m_kWaiting.pop_back();
        COrnHTMLWriter own = ObjectPage();
        AddTables(own, next);
        Save(own, GetHTMLFileName(next, EHTMLPath::Bare));
    }
}

std::string CHTMLDump::WriteSite(CObject& root)
{
    const std::string ending = (++m_uiSites == 1 ? "" : std::to_string(m_uiSites)) + ".htm";
    Save(IndexPage(root, "TreeView" + ending), "Index" + ending);
    Save(TreePage(TreeOf(root, m_kInTree)), "TreeView" + ending);
    if (!m_kKnown.contains(&root))
    {
        COrnHTMLWriter page = ObjectPage();
        Fill(page, root);
        Save(page, GetHTMLFileName(root, EHTMLPath::Bare));
    }
    return "Index" + ending;
}

} // namespace gw
