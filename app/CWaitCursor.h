#pragma once

#include "CContentWindow.h"

namespace gw {

/// Shows the wait cursor for as long as it lives.
class CWaitCursor
{
public:
    explicit CWaitCursor(CContentWindow& window) : m_kWindow(window) { m_kWindow.BeginWaitCursor(); }
    ~CWaitCursor() { m_kWindow.EndWaitCursor(); }
    CWaitCursor(const CWaitCursor&) = delete;
    CWaitCursor& operator=(const CWaitCursor&) = delete;

private:
    CContentWindow& m_kWindow;
};

} // namespace gw
