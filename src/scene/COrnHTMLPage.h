#pragma once

#include <cstdio>
#include <string>
#include <vector>

namespace gw {

/// A text page under construction: lines, followed by nested pages.
class COrnHTMLPage
{
public:
    virtual ~COrnHTMLPage() = default;

    /// Writes the page to a file, replacing an old one atomically. Returns false and keeps the old file if it
    /// cannot be written or is not a regular file, since a link could point outside the folder.
    virtual bool SaveAs(const std::string& path) const;
    virtual bool SaveAsText(const char* path) const { return SaveAs(path); }
    /// Prints the lines with their line ends, then the nested pages.
    virtual void WriteTo(std::FILE* file) const;

    /// Returns what WriteTo prints.
    std::string Text() const;

    void AddLine(std::string line) { m_kLines.push_back(std::move(line)); }
    /// Adds a line formatted as by printf.
    [[gnu::format(printf, 2, 3)]] void AddFormat(const char* format, ...);
    void AddPage(COrnHTMLPage page) { m_kPages.push_back(std::move(page)); }

private:
    std::vector<std::string> m_kLines;
    std::vector<COrnHTMLPage> m_kPages;
};

/// The page class that callers use.
class COrnHTMLWriter : public COrnHTMLPage
{
};

} // namespace gw
