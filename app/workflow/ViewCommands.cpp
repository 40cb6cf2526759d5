// What the user does in the views: follow the figure, pick a bone.

#include "CGaitConvertContent.h"
#include "CProfileEditorDialog.h"

namespace gw {

namespace {

constexpr const char* kFollowSetting = "Follow";
constexpr const char* kFollowing = "1";

} // namespace

void CGaitConvertContent::RestoreFollow()
{
    SetFollow(platform_.ReadSetting(kFollowSetting) == kFollowing);
}

void CGaitConvertContent::SetFollow(bool on)
{
    m_bFollows = on;
    if (on != (platform_.ReadSetting(kFollowSetting) == kFollowing))
        platform_.WriteSetting(kFollowSetting, on ? kFollowing : "");
    for (CMotionView* view : {m_pkSourceView.get(), m_pkResultView.get()})
    {
        if (view)
            view->SetFollow(on);
    }
}

void CGaitConvertContent::ClickBone(std::string_view child, const std::string& bone)
{
    CProfileEditorDialog& editor = *m_pkProfileDialog;
    if (child == kSourceViewChild)
        editor.SelectSourceItem(editor.FindSourceItem(bone));
    else
        editor.SelectTargetItem(editor.FindTargetItem(bone));
}

} // namespace gw
