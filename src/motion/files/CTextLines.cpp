#include "CTextLines.h"

#include "Text.h"

namespace gw {

namespace {

constexpr size_t kForgetInterval = size_t{8} << 20;
constexpr size_t kReportInterval = size_t{1} << 18;

// Returns the characters before a line feed, without its carriage return.
std::string_view CutLineEnd(std::string_view text, size_t feed)
{
    const bool pair = feed > 0 && text[feed - 1] == '\r';
    return text.substr(0, pair ? feed - 1 : feed);
}

} // namespace

EFailure CTextLines::Open(const std::string& path)
{
    Close();
    const EFailure failure = m_kFile.Open(path);
    m_kNow.m_uiOffset = m_kFile.Text().size() - SkipByteOrderMark(m_kFile.Text()).size();
    return failure;
}

void CTextLines::Close()
{
    m_kFile.Close();
    m_kNow = m_kBefore = {};
    m_uiForgotten = 0;
    m_uiReported = 0;
}

void CTextLines::StepBack()
{
    m_kNow = m_kBefore;
}

void CTextLines::ForgetRead()
{
    if (m_kNow.m_uiOffset - m_uiReported < kReportInterval)
        return;
    m_uiReported = m_kNow.m_uiOffset;
    if (progress_)
        progress_(m_uiReported, ByteCount());
    if (m_kNow.m_uiOffset - m_uiForgotten < kForgetInterval)
        return;
    m_uiForgotten = m_kNow.m_uiOffset;
    m_kFile.Forget(m_uiForgotten);
}

// Returns the rest of the text. The line number advances with the first piece of a line.
std::string_view CTextLines::BeginRead()
{
    m_kBefore = m_kNow;
    const std::string_view rest = m_kFile.Text().substr(m_kNow.m_uiOffset);
    if (!rest.empty() && !m_kNow.m_bInsideLine)
        ++m_kNow.m_uiLine;
    return rest;
}

bool CTextLines::Next(std::string_view& line)
{
    const std::string_view rest = BeginRead();
    if (rest.empty())
        return false;
    // The line end may follow the longest piece and counts as one more character: a line of exactly that
    // length is returned as itself and an empty piece.
    const std::string_view window = rest.substr(0, kPieceLength + 2);
    const size_t feed = window.find('\n');
    line = feed == window.npos ? window : CutLineEnd(window, feed);
    const bool lineEnds = feed != window.npos && line.size() < kPieceLength;
    line = line.substr(0, kPieceLength);
    m_kNow.m_bInsideLine = !lineEnds;
    m_kNow.m_uiOffset += lineEnds ? feed + 1 : line.size();
    return true;
}

bool CTextLines::NextRow(std::string_view& row)
{
    const std::string_view rest = BeginRead();
    if (rest.empty())
        return false;
    const size_t feed = rest.find('\n');
    row = feed == rest.npos ? rest : CutLineEnd(rest, feed);
    m_kNow.m_bInsideLine = false;
    m_kNow.m_uiOffset += feed == rest.npos ? rest.size() : feed + 1;
    return true;
}

std::string Quote(std::string_view text)
{
    constexpr size_t kLongestQuote = 80;
    return std::string(text.substr(0, kLongestQuote));
}

} // namespace gw
