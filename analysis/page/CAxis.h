#pragma once

#include <vector>

namespace gw {

/// An axis whose ends are round numbers.
class CAxis
{
public:
    /// Contains all numbers from `least` to `largest` in about `count` steps.
    CAxis(double least, double largest, int count);

    /// Returns the round numbers from the low end to the high end.
    std::vector<double> Ticks() const;
    /// Returns the number of decimals that distinguishes ticks.
    int Decimals() const { return m_iDecimals; }
    /// Returns the position of a number between the ends, 0 to 1.
    double Share(double value) const { return (value - m_fLow) / (m_fHigh - m_fLow); }

private:
    double m_fLow;
    double m_fHigh;
    double m_fStep;
    int m_iDecimals;
};

} // namespace gw
