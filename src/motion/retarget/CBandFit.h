#pragma once

#include <cstddef>
#include <vector>

namespace gw {

/// A smooth curve of one value a frame by least squares, for all frames at once: it minimises
///
///     sum of weights x (value - wanted)^2 + weights x (step - wanted)^2 + bend x (second difference)^2
///
/// in a time that is linear in the frames. What is asked for with a number that is not finite is passed over.
class CBandFit
{
public:
    /// `bend` is the weight of the second differences. With `rest` above 0 each value is wanted at 0 by so
    /// little that it counts only where nothing else is asked for.
    CBandFit(size_t frameCount, double bend, double rest);

    void AddValue(size_t frame, double weight, double wanted);
    /// For the value after `frame` less the one at it.
    void AddStep(size_t frame, double weight, double wanted);
    /// More weight for the second difference of a frame and the two after it.
    void AddBend(size_t frame, double weight);
    /// The curve. To be called once: the equations are solved where they stand.
    std::vector<double> Solve();

private:
    void Factor();

    std::vector<double> m_kDiagonal;
    std::vector<double> m_kNext;      // between a frame and the next one
    std::vector<double> m_kAfterNext; // and the one after that
    std::vector<double> m_kWanted;
};

/// The weight of second differences at which a curve follows a weight of 1 up to a frequency in Hz and is
/// smoothed above it.
double BendWeight(double hertz, double secondsPerFrame);

/// The frequency at which feet and hands go back to their free paths, when nothing holds them any more: they
/// are there after 0.2 s.
inline constexpr double kReturnHertz = 2.0;

} // namespace gw
