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

/// Control ids of the map tool, apart from its transport buttons; the numbers never change.
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

/// The five transport buttons of each motion: first frame, step back, stop, play, step forward.
inline constexpr int kTransportIds[3][5] = {
    {1010, 1017, 1018, 1019, 1020},
    {1021, 1022, 1023, 1024, 1025},
    {1026, 1027, 1028, 1029, 1030},
};

/// The map tool without its window: three motions, two bone trees and a list of map lines that convert one
/// motion to another's skeleton. A window displays the accessors' values and forwards user actions. Nothing
/// is asked or reported in message boxes; Status() describes the outcome of the last operation.
class CGaitToolDialog
{
public:
    static constexpr int kClockMilliseconds = 17;

    /// Both arguments must outlive the tool.
    CGaitToolDialog(CToolWindow& window, const CPlatform& platform);
    ~CGaitToolDialog();
    CGaitToolDialog(const CGaitToolDialog&) = delete;
    CGaitToolDialog& operator=(const CGaitToolDialog&) = delete;

    /// Creates the views through the window. Everything else works without them.
    void OnInitDialog();

    // Events from a window.
    /// Handles a button click; ignores disabled buttons and unknown ids.
    void ClickButton(int id);
    /// Selects a line, or none with -1, and the bones of a mapping in the trees.
    void SelectLine(int index);
    void SelectSourceItem(int item) { m_kSourceTree.Select(item); }
    void SelectTargetItem(int item) { m_kTargetTree.Select(item); }
    /// Returns whether a file can be dropped, by its extension.
    static bool TakesFile(const std::string& path);
    /// Loads a file dropped on a motion's view. Returns false for the result, which cannot be loaded.
    bool DropFile(EToolMotion motion, const std::string& path);
    /// Advances the clock of all three views by one tick. Returns whether any of them is still playing.
    bool Advance();

    // Operations. If one fails, it returns false and leaves motions and lines unchanged; the status says why.
    /// Loads a source, and reloads the fixed target skeleton.
    bool LoadSource(const std::string& path);
    bool LoadTarget(const std::string& path);
    bool LoadMap(const std::string& path);
    bool SaveMap(const std::string& path);
    /// Moves the result like the source, according to the lines. Missing bones have no effect.
    void Convert();
    /// Writes the result, or the target's own motion if nothing has been converted yet.
    bool SaveResult(const std::string& path);

    // State for a window to show.
    bool IsEnabled(int id) const;
    const CMapLineList& Map() const { return m_kMap; }
    const CBoneTree& SourceTree() const { return m_kSourceTree; }
    const CBoneTree& TargetTree() const { return m_kTargetTree; }
    const CMotionFile& Motion(EToolMotion motion) const { return m_kMotions[Index(motion)]; }
    bool IsConverted() const { return m_bConverted; }
    bool IsPlaying() const;
    /// Returns the frame that a view shows, starting at 0, and the last frame of its motion.
    int FrameOf(EToolMotion motion) const;
    int LastFrameOf(EToolMotion motion) const;
    /// Returns the outcome of the last operation as a sentence that is safe to print.
    const std::string& Status() const { return m_kStatus; }

private:
    struct Command;
    static const Command* FindCommand(int id);

    // Button commands.
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

    // Conditions under which buttons are enabled.
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
    bool IsPelvisFree(const CBoneNames& targets) const;
    void ApplyLine(CRetargeter& retargeter, const MapLine& line, const CBoneNames& sources,
                   const CBoneNames& targets);

    CToolWindow& window_;
    const CPlatform& platform_;
    std::array<CMotionFile, 3> m_kMotions;
    std::string m_kTargetPath; ///< the file that target and result were read from
    std::array<std::unique_ptr<CMotionView>, 3> m_kViews;
    CBoneTree m_kSourceTree;
    CBoneTree m_kTargetTree;
    CMapLineList m_kMap;
    bool m_bConverted = false; ///< the result follows the source and differs from the file
    std::string m_kStatus;
};

} // namespace gw
