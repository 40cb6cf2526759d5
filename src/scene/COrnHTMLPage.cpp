#include "COrnHTMLPage.h"

#include <cstdarg>

namespace gw {

bool COrnHTMLPage::SaveAs(const std::string& path) const
{
    std::FILE* file = std::fopen(path.c_str(), "wt");
    if (!file)
        return false;
    WriteTo(file);
    const bool taken = !std::ferror(file);
    return std::fclose(file) == 0 && taken;
}

void COrnHTMLPage::WriteTo(std::FILE* file) const
{
    for (const std::string& line : m_kLines)
        std::fprintf(file, "%s\n", line.c_str());
    for (const COrnHTMLPage& page : m_kPages)
        page.WriteTo(file);
}

void COrnHTMLPage::AddFormat(const char* format, ...)
{
    static std::string buffer; // one for the program, as long as its longest line
    va_list arguments;
    va_start(arguments, format);
    va_list again;
    va_copy(again, arguments);
    const int length = std::vsnprintf(nullptr, 0, format, arguments);
    buffer.resize(length < 0 ? 0 : static_cast<size_t>(length));
    std::vsnprintf(buffer.data(), buffer.size() + 1, format, again);
    va_end(again);
    va_end(arguments);
    AddLine(buffer);
}

} // namespace gw
