#pragma once

#include "MotionMarks.h"

#include <memory>
#include <mutex>
#include <optional>
#include <vector>

namespace gw {

class CKeyframeControl;
class CMapRowTable;
class CMotionFile;
class CNode;

/// Measures conversions in the background, on copies of both motions, at the lowest priority. The copies are
/// made and destroyed on the caller's thread, because only one thread may create or delete scene objects; the
/// other thread only poses them.
class CMarksMeter
{
public:
    CMarksMeter();
    /// Waits for a measurement that is still running; 20,000 frames take 0.2 seconds.
    ~CMarksMeter();
    CMarksMeter(const CMarksMeter&) = delete;
    CMarksMeter& operator=(const CMarksMeter&) = delete;

    /// Begins to measure a finished conversion, and cancels the previous measurement. `source` moves by
    /// `track`; the rows are those that drove the result. Nothing is kept alive or changed.
    void Start(CNode& source, const CKeyframeControl& track, const CMotionFile& result,
               const CMapRowTable& rows);
    /// Forgets the present measurement without waiting for it.
    void Cancel();
    bool IsMeasuring() const { return m_spJob != nullptr; }
    /// Returns the marks once they are measured, and only once.
    std::optional<MotionMarks> Take();

private:
    class CJob;

    void DropFinished();

    std::unique_ptr<CJob> m_spJob;
    std::vector<std::unique_ptr<CJob>> m_kCanceled; // still running
    std::mutex m_kTurn;                             // one measurement at a time
};

} // namespace gw
