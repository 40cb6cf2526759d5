#pragma once

namespace gw {

/// Shows a window's wait cursor for as long as it lives.
template <class TWindow>
class CWaitCursor
{
public:
    explicit CWaitCursor(TWindow& window) : m_kWindow(window) { m_kWindow.BeginWaitCursor(); }
    ~CWaitCursor() { m_kWindow.EndWaitCursor(); }
    CWaitCursor(const CWaitCursor&) = delete;
    CWaitCursor& operator=(const CWaitCursor&) = delete;

private:
    TWindow& m_kWindow;
};

} // namespace gw
