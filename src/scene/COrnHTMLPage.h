#pragma once

#include <cstdio>
#include <string>
#include <vector>

namespace gw {

/// A text page that is being made: lines, and pages that follow them.
class COrnHTMLPage
{
public:
    virtual ~COrnHTMLPage() = default;

    /// Writes the page to a file, replacing an old one in one step. False, with the old one kept, if the file
    /// cannot be written or is not a regular file: a link could lead out of the folder.
    virtual bool SaveAs(const std::string& path) const;
    virtual bool SaveAsText(const char* path) const { return SaveAs(path); }
    /// Prints the lines, each with its end, and then the nested pages.
    virtual void WriteTo(std::FILE* file) const;

    void AddLine(std::string line) { m_kLines.push_back(std::move(line)); }
    /// A line as printf makes it.
    [[gnu::format(printf, 2, 3)]] void AddFormat(const char* format, ...);
    void AddPage(COrnHTMLPage page) { m_kPages.push_back(std::move(page)); }

private:
    std::vector<std::string> m_kLines;
    std::vector<COrnHTMLPage> m_kPages;
};

/// The class through which pages are used.
class COrnHTMLWriter : public COrnHTMLPage
{
};

} // namespace gw
