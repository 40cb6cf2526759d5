#include "COrnHTMLPage.h"

#include "CSafeFile.h"
#include "Paths.h"

#include <cstdarg>

namespace gw {

bool COrnHTMLPage::SaveAs(const std::string& path) const
{
    CSafeFile file;
    if (IsLink(path) || !file.Open(path))
        return false;
    std::FILE* const stream = TextStreamTo(file);
    if (!stream)
        return false;
    WriteTo(stream);
    return std::fclose(stream) == 0 && file.Commit(); // fails if any write failed
}

void COrnHTMLPage::WriteTo(std::FILE* file) const
{
    for (const std::string& line : m_kLines)
        std::fprintf(file, "%s\n", line.c_str());
    for (const COrnHTMLPage& page : m_kPages)
        page.WriteTo(file);
}

std::string COrnHTMLPage::Text() const
{
    std::string text;
    for (const std::string& line : m_kLines)
        text.append(line).append("\n");
    for (const COrnHTMLPage& page : m_kPages)
        text += page.Text();
    return text;
}

void COrnHTMLPage::AddFormat(const char* format, ...)
{
    va_list arguments;
    va_start(arguments, format);
    const int length = std::vsnprintf(nullptr, 0, format, arguments);
    va_end(arguments);
    std::string line(length < 0 ? 0 : static_cast<size_t>(length), ' ');
    va_start(arguments, format);
    std::vsnprintf(line.data(), line.size() + 1, format, arguments);
    va_end(arguments);
    AddLine(std::move(line));
}

} // namespace gw
