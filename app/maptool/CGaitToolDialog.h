#pragma once

#include "CBoneTree.h"
#include "CMapLineList.h"
#include "CMotionFile.h"
#include "CToolWindow.h"

#include <array>
#include <cstddef>
#include <memory>
#include <string>

namespace gw {

class CBoneNames;
class CPlatform;
class CRetargeter;

/// Controls of the map tool beside its transport buttons, with the numbers that they have always had.
enum EToolControl : int
{
    kToolClose = 1,
    kToolLoadSource = 1000,
    kToolLoadTarget = 1001,
    kToolAddToMap = 1006,
    kToolLines = 1008,
    kToolDelete = 1009,
    kToolDeleteAll = 1011,
    kToolLoadMap = 1012,
    kToolSaveMap = 1013,
    kToolConvert = 1014,
    kToolSaveResult = 1016,
    kToolDetail = 1033,
};

/// The five transport buttons of each motion: to the start, a step back, stop, play, a step on.
inline constexpr int kTransportIds[3][5] = {
    {1010, 1017, 1018, 1019, 1020},
    {1021, 1022, 1023, 1024, 1025},
    {1026, 1027, 1028, 1029, 1030},
};

/// The map tool without its window: three motions, two trees of bones and a list of map lines by which one
/// motion is converted onto the skeleton of another. A window shows what the accessors answer and forwards
/// what the user does. Nothing is asked and nothing is reported in boxes: what became of an operation stands
/// in Status().
class CGaitToolDialog
{
public:
    static constexpr int kClockMilliseconds = 17;

    /// Both ports must outlive the tool.
    CGaitToolDialog(CToolWindow& window, const CPlatform& platform);
    ~CGaitToolDialog();
    CGaitToolDialog(const CGaitToolDialog&) = delete;
    CGaitToolDialog& operator=(const CGaitToolDialog&) = delete;

    /// Takes the views from the window. All else works without them.
    void OnInitDialog();

    // What a window delivers.
    /// A button was clicked; nothing for a disabled one and for ids that are none.
    void ClickButton(int id);
    /// A line was selected, or none with -1. The bones of a mapping are selected in the trees.
    void SelectLine(int index);
    void SelectSourceItem(int item) { m_kSourceTree.Select(item); }
    void SelectTargetItem(int item) { m_kTargetTree.Select(item); }
    /// Whether a file may be dropped at all, by its extension.
    static bool TakesFile(const std::string& path);
    /// A file was dropped on the view of a motion: loads it there. False for the result, which is no file's.
    bool DropFile(EToolMotion motion, const std::string& path);
    /// One tick of the clock for all three views; whether any of them still plays.
    bool Advance();

    // The operations behind. False leaves motions and lines as they were; the status says why.
    /// Besides the source, takes the fixed target skeleton again.
    bool LoadSource(const std::string& path);
    bool LoadTarget(const std::string& path);
    bool LoadMap(const std::string& path);
    bool SaveMap(const std::string& path);
    /// Moves the result after the source as the lines say. Bones that are not there have no effect.
    void Convert();
    /// Writes the result, or before a conversion the target's own motion.
    bool SaveResult(const std::string& path);

    // What a window shows.
    bool IsEnabled(int id) const;
    const CMapLineList& Map() const { return m_kMap; }
    const CBoneTree& SourceTree() const { return m_kSourceTree; }
    const CBoneTree& TargetTree() const { return m_kTargetTree; }
    const CMotionFile& Motion(EToolMotion motion) const { return m_kMotions[Index(motion)]; }
    bool IsConverted() const { return m_bConverted; }
    bool IsPlaying() const;
    /// The frame that a view shows, from 0 on, and the last one of its motion.
    int FrameOf(EToolMotion motion) const;
    int LastFrameOf(EToolMotion motion) const;
    /// What became of the last operation, as a sentence; safe to print.
    const std::string& Status() const { return m_kStatus; }

private:
    struct Command;
    static const Command* FindCommand(int id);

    // The commands of the buttons.
    void AskSource();
    void AskTarget();
    void AddToMap();
    void RemoveLine();
    void RemoveAllLines();
    void AskMap();
    void AskMapPath();
    void AskResultPath();
    void EditDetail();
    void Close() { window_.CloseWindow(); }

    // When they take a click.
    bool Always() const { return true; }
    bool HasBothTrees() const { return !m_kSourceTree.Items().empty() && !m_kTargetTree.Items().empty(); }
    bool HasLines() const { return !m_kMap.IsEmpty(); }
    bool HasSelectedLine() const { return m_kMap.SelectedLine(); }
    bool HasTarget() const { return Motion(EToolMotion::Target).motionRoot.Get(); }

    static size_t Index(EToolMotion motion) { return static_cast<size_t>(motion); }
    CNode* Root(EToolMotion motion) const { return Motion(motion).motionRoot.Get(); }
    CMotionView* View(EToolMotion motion) const { return m_kViews[Index(motion)].get(); }
    void ClickTransport(int id);
    bool Load(EToolMotion motion, const std::string& path);
    bool LoadTargetMotions(const std::string& path);
    void ShowMotion(EToolMotion motion);
    void TakeSkeletons();
    void MarkBones();
    bool IsMappable(const MapLine& line) const;
    void ApplyLine(CRetargeter& retargeter, const MapLine& line, const CBoneNames& sources,
                   const CBoneNames& targets);

    CToolWindow& window_;
    const CPlatform& platform_;
    std::array<CMotionFile, 3> m_kMotions;
    std::string m_kTargetPath; ///< of the file that target and result were read from
    std::array<std::unique_ptr<CMotionView>, 3> m_kViews;
    CBoneTree m_kSourceTree;
    CBoneTree m_kTargetTree;
    CMapLineList m_kMap;
    bool m_bConverted = false; ///< the result moves after the source, and no longer stands as it was read
    std::string m_kStatus;
};

} // namespace gw
