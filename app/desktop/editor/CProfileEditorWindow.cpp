#include "CProfileEditorWindow.h"

namespace gw {

CProfileEditorWindow::CProfileEditorWindow(CGaitConvertContent&, CPlatform&, QWidget* owner) : QDialog(owner)
{
}

void CProfileEditorWindow::SetShown(bool shown)
{
    setVisible(shown);
}

void CProfileEditorWindow::Refresh() {}

bool CProfileEditorWindow::RunBoneOffset(CBoneOffsetDialog&)
{
    return false;
}

} // namespace gw
