#pragma once

#include <cstddef>
#include <vector>

namespace gw {

/// Fits a smooth curve with one value per frame by least squares over all frames. The curve minimizes
///
///     sum of weights x (value - wanted)^2 + weights x (step - wanted)^2 + bend x (second difference)^2
///
/// in time linear in the number of frames. Requests with a non-finite weight or value are ignored.
class CBandFit
{
public:
    /// `bend` is the weight of the second differences. `rest` is the weight that pulls each value toward 0; a
    /// small one matters only in frames without other requests.
    CBandFit(size_t frameCount, double bend, double rest);

    /// Requests a value for a frame.
    void AddValue(size_t frame, double weight, double wanted);
    /// Requests a difference: the value at `frame` + 1 minus the value at `frame`.
    void AddStep(size_t frame, double weight, double wanted);
    /// Adds weight to the second difference of `frame` and the next two frames.
    void AddBend(size_t frame, double weight);
    /// Returns the curve, one value per frame. Call it only once: the equations are solved in place.
    std::vector<double> Solve();

private:
    void Factor();

    std::vector<double> m_kDiagonal;
    std::vector<double> m_kNext;      // coefficients between a frame and the next one
    std::vector<double> m_kAfterNext; // coefficients between a frame and the one after that
    std::vector<double> m_kWanted;
};

/// Returns the bend weight for a cutoff frequency in Hz: values with weight 1 are followed below it and
/// smoothed out above it.
double BendWeight(double hertz, double secondsPerFrame);

} // namespace gw
