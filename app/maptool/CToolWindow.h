#pragma once

#include "CContentWindow.h"
#include "CMotionView.h"

#include <cstdint>
#include <memory>
#include <optional>
#include <string>

namespace gw {

struct MapLine;

/// The three motions of the map tool.
enum class EToolMotion : uint8_t
{
    Source,
    Target,
    Result,
};

inline constexpr EToolMotion kToolMotions[] = {EToolMotion::Source, EToolMotion::Target, EToolMotion::Result};

/// The window as seen by the map tool.
class CToolWindow
{
public:
    virtual ~CToolWindow() = default;

    /// Returns a path, or nothing if the dialog was canceled.
    virtual std::optional<std::string> AskOpenFile(const FileDialogSetup& setup) = 0;
    /// Same for saving; the dialog itself asks before a file is replaced.
    virtual std::optional<std::string> AskSaveFile(const FileDialogSetup& setup) = 0;
    /// Runs the dialog for the line's kind, which can change numbers, frame rate or text. Returns true on OK.
    virtual bool EditLine(MapLine& line) = 0;
    /// Returns the view of a motion, or null.
    virtual std::unique_ptr<CMotionView> CreateView(EToolMotion) { return nullptr; }
    virtual void CloseWindow() = 0;
    virtual void BeginWaitCursor() {}
    virtual void EndWaitCursor() {}
};

} // namespace gw
