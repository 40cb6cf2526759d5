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

/// The window as the map tool sees it.
class CToolWindow
{
public:
    virtual ~CToolWindow() = default;

    /// A path, or none when the dialog was cancelled.
    virtual std::optional<std::string> AskOpenFile(const FileDialogSetup& setup) = 0;
    /// The same; the dialog itself asks before a file is replaced.
    virtual std::optional<std::string> AskSaveFile(const FileDialogSetup& setup) = 0;
    /// Shows the dialog of the line's kind until the user ends it: numbers, frame rate or text may be others
    /// then. True on OK.
    virtual bool EditLine(MapLine& line) = 0;
    /// The view of a motion, or null where there is none.
    virtual std::unique_ptr<CMotionView> CreateView(EToolMotion) { return nullptr; }
    virtual void CloseWindow() = 0;
    virtual void BeginWaitCursor() {}
    virtual void EndWaitCursor() {}
};

} // namespace gw
