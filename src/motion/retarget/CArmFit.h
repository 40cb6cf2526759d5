#pragma once

#include <array>
#include <cstddef>
#include <vector>

namespace gw {

/// Fits several smooth curves at once by least squares, with one value each per sample. Unlike for CBandFit,
/// a request may involve all values of a sample. The curves minimize
///
///     sum of weights x (coefficients . values - wanted)^2 + scales x (values^2 + bend x second
///     differences^2)
///
/// in time linear in the number of samples.
class CArmFit
{
public:
    static constexpr size_t kValues = 5;
    using Values = std::array<double, kValues>;

    /// `scales` weighs the curves against each other; `bend` is as for CBandFit.
    CArmFit(size_t sampleCount, const Values& scales, double bend);

    /// Requests a value for a linear combination of a sample's values. Ignored if anything is not finite.
    void AddRequest(size_t sample, double weight, const Values& coefficients, double wanted);
    /// Pulls the values of a sample toward others, each with its curve's scale times the weight.
    void AddPull(size_t sample, double weight, const Values& wanted);
    /// Returns the curves, one group of values per sample. Call it only once: the equations are solved in
    /// place.
    std::vector<Values> Solve();

private:
    // A row of the upper half of the matrix, from the diagonal on; what is two samples farther is zero.
    static constexpr size_t kBand = 2 * kValues + 1;
    using Row = std::array<double, kBand>;
    // Zero rows after the last one, so that loops over a row's band have constant bounds and get unrolled.
    static constexpr size_t kPadding = kBand - 1;

    void Factor();

    Values m_kScales;
    size_t m_uiCount; // of rows, without the padding
    std::vector<Row> m_kRows;
    std::vector<double> m_kWanted;
};

} // namespace gw
