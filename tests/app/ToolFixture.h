#pragma once

#include "CGaitToolDialog.h"

#include "ContentFixture.h"
#include "FindBone.h"
#include "Paths.h"

#include <algorithm>

namespace gw {

/// A window with scripted answers.
class CScriptedToolWindow : public CToolWindow
{
public:
    std::optional<std::string> AskOpenFile(const FileDialogSetup& setup) override { return Ask(setup); }
    std::optional<std::string> AskSaveFile(const FileDialogSetup& setup) override { return Ask(setup); }
    bool EditLine(MapLine& line) override
    {
        m_kEdited = line;
        return onEdit && (onEdit(line), true);
    }
    std::unique_ptr<CMotionView> CreateView(EToolMotion motion) override
    {
        auto view = std::make_unique<CWatchedView>();
        m_pkViews[static_cast<size_t>(motion)] = view.get();
        return view;
    }
    void CloseWindow() override { m_bClosed = true; }

    CWatchedView& View(EToolMotion motion) { return *m_pkViews[static_cast<size_t>(motion)]; }

    std::optional<std::string> answer;
    FileDialogSetup m_kAsked;
    std::function<void(MapLine&)> onEdit; ///< the user's changes before OK; not set: cancels
    MapLine m_kEdited;
    bool m_bClosed = false;

private:
    std::optional<std::string> Ask(const FileDialogSetup& setup)
    {
        m_kAsked = setup;
        return answer;
    }

    CWatchedView* m_pkViews[3] = {};
};

inline constexpr const char* kHead = "Unknown Source|Position 0,0,0|FrameRate 60|";

class ToolTest : public ContentTest
{
protected:
    ToolTest() { m_kTool.OnInitDialog(); }

    void Click(int id, const std::string& file = {})
    {
        m_kToolWindow.answer = file.empty() ? std::nullopt : std::optional(m_kFolder.Path(file));
        m_kTool.ClickButton(id);
    }
    /// Loads a walk of `frameCount` frames.
    void LoadSource(int frameCount = 3)
    {
        Write("walk.bvh", BvhText(kPoserBones, frameCount));
        Click(kToolLoadSource, "walk.bvh");
    }
    /// Loads a map with these lines, each ended by "|".
    void LoadMap(std::string lines)
    {
        std::ranges::replace(lines, '|', '\n');
        Write("map.txt", lines);
        Click(kToolLoadMap, "map.txt");
    }
    std::string Lines() const
    {
        std::string text;
        for (const MapLine& line : m_kTool.Map().Lines())
            text += line.text + '|';
        return text;
    }
    void Add(const char* source, const char* target)
    {
        m_kTool.SelectSourceItem(m_kTool.SourceTree().Find(source));
        m_kTool.SelectTargetItem(m_kTool.TargetTree().Find(target));
        Click(kToolAddToMap);
    }
    /// Returns the marked bones: "hip lThigh > LowerTorso".
    std::string Marked() const
    {
        return MarkedOf(m_kTool.SourceTree()) + '>' + MarkedOf(m_kTool.TargetTree());
    }
    std::set<int> Enabled() const
    {
        std::set<int> ids;
        for (int id :
             {kToolClose, kToolLoadSource, kToolLoadTarget, kToolAddToMap, kToolDelete, kToolDeleteAll,
              kToolLoadMap, kToolSaveMap, kToolConvert, kToolSaveResult, kToolDetail})
        {
            if (m_kTool.IsEnabled(id))
                ids.insert(id);
        }
        return ids;
    }
    CNode* Bone(EToolMotion motion, const char* name) const
    {
        return FindBone(m_kTool.Motion(motion).motionRoot.Get(), name);
    }
    /// Returns the world matrix of a result bone at a frame.
    Mat4 ResultAt(const char* name, int frame)
    {
        m_kToolWindow.View(EToolMotion::Result).SeekStart();
        for (int step = 0; step < frame; ++step)
            m_kToolWindow.View(EToolMotion::Result).StepForward();
        return Bone(EToolMotion::Result, name)->m_kWorldMatrix;
    }

    /// Returns the world matrices of all result bones, frame by frame.
    std::vector<Mat4> ResultPoses()
    {
        std::vector<Mat4> poses;
        for (int frame = 0; frame <= m_kTool.LastFrameOf(EToolMotion::Result); ++frame)
        {
            for (const CBoneTree::Item& bone : m_kTool.TargetTree().Items())
                poses.push_back(ResultAt(bone.m_kText.c_str(), frame));
        }
        return poses;
    }

    CScriptedToolWindow m_kToolWindow;
    CGaitToolDialog m_kTool{m_kToolWindow, m_kPlatform};

private:
    static std::string MarkedOf(const CBoneTree& tree)
    {
        std::string names;
        for (size_t item = 0; item < tree.Items().size(); ++item)
        {
            if (tree.IsMapped(static_cast<int>(item)))
                names += ' ' + tree.Items()[item].m_kText + ' ';
        }
        return names;
    }
};

inline const std::string kMap =
    "Walk|Position 1,2,3|FrameRate 30|hip <---> LowerTorso .|lThigh <---> LThigh 10,20,30|"
    "* LPelvis . .1,2,3|rThigh <---> RThigh .|lFoot <---> LFoot .|rFoot <---> RFoot .|";

} // namespace gw
