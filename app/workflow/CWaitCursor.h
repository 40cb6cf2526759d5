#pragma once

namespace gw {

/// Shows a window's wait cursor while it exists.
template <class TWindow>
class CWaitCursor
{
public:
    explicit CWaitCursor(TWindow& window) : window_(window) { window_.BeginWaitCursor(); }
    ~CWaitCursor() { window_.EndWaitCursor(); }
    CWaitCursor(const CWaitCursor&) = delete;
    CWaitCursor& operator=(const CWaitCursor&) = delete;

private:
    TWindow& window_;
};

} // namespace gw
