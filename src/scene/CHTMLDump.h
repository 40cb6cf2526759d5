#pragma once

#include "COrnHTMLPage.h"

#include <string>
#include <unordered_set>
#include <vector>

namespace gw {

class CObject;

/// Writes the pages of one dump: one for every object, however often it is linked. Objects wait in a list for
/// their page, so that no graph is too deep and none without an end.
class CHTMLDump
{
public:
    /// File names come straight behind `folder`, which ends in a separator.
    explicit CHTMLDump(std::string folder) : m_kFolder(std::move(folder)) {}

    /// Puts an object's tables on a page, and saves the pages of all that it leads to.
    void Fill(COrnHTMLPage& page, CObject& object);
    /// The frames, the tree of the nodes below a root (of itself alone where it is no node), and the pages.
    /// Several roots share the folder and the pages, and a node stands in the tree of one of them. Answers
    /// the name of the frames' page: Index.htm, Index2.htm and so on.
    std::string WriteSite(CObject& root);

    size_t PageCount() const { return m_uiPages; }
    /// Pages whose file could not be written.
    size_t FailedCount() const { return m_uiFailed; }

private:
    void Save(const COrnHTMLPage& page, const std::string& fileName);
    void AddTables(COrnHTMLPage& page, CObject& object);

    std::string m_kFolder;
    std::unordered_set<const CObject*> m_kKnown;  // those with a page
    std::unordered_set<const CObject*> m_kInTree; // nodes that stand in a tree
    std::vector<CObject*> m_kWaiting;
    size_t m_uiSites = 0;
    size_t m_uiPages = 0;
    size_t m_uiFailed = 0;
};

} // namespace gw
