#pragma once

#include <vector>

namespace gw {

/// An axis whose ends are round numbers.
class CAxis
{
public:
    /// Holds all numbers from `least` through `largest` and has about `count` steps.
    CAxis(double least, double largest, int count);

    /// The round numbers, from the low end to the high one.
    std::vector<double> Ticks() const;
    /// Decimals that tell one tick from the next.
    int Decimals() const { return m_iDecimals; }
    /// Where a number lies between the ends, 0 to 1.
    double Share(double value) const { return (value - m_fLow) / (m_fHigh - m_fLow); }

private:
    double m_fLow;
    double m_fHigh;
    double m_fStep;
    int m_iDecimals;
};

} // namespace gw
