// As in CBandFit, the derivatives of the sum give a symmetric, positive definite band matrix, which is
// factored as transpose(U) · D · U without pivoting. Here each sample has several equations, and a curve's
// second differences reach two samples ahead, so the band is wider.

#include "CArmFit.h"

#include <algorithm>
#include <cmath>

namespace gw {

CArmFit::CArmFit(size_t sampleCount, const Values& scales, double bend)
    : m_kScales(scales), m_uiCount(sampleCount * kValues), m_kRows(m_uiCount + kPadding, Row{}),
      m_kWanted(m_uiCount + kPadding, 0.0)
{
    constexpr double kSecond[] = {1.0, -2.0, 1.0};
    for (size_t row = 0; row < m_uiCount; ++row)
    {
        const double scale = scales[row % kValues];
        m_kRows[row][0] += scale;
        if (row + 2 * kValues >= m_uiCount)
            continue;
        for (size_t i = 0; i < 3; ++i)
        {
            for (size_t j = i; j < 3; ++j)
                m_kRows[row + i * kValues][(j - i) * kValues] += scale * bend * kSecond[i] * kSecond[j];
        }
    }
}

void CArmFit::AddRequest(size_t sample, double weight, const Values& coefficients, double wanted)
{
    double check = weight * wanted;
    for (const double coefficient : coefficients)
        check += coefficient;
    if (!std::isfinite(check))
        return;
    const size_t first = sample * kValues;
    for (size_t i = 0; i < kValues; ++i)
    {
        for (size_t j = i; j < kValues; ++j)
            m_kRows[first + i][j - i] += weight * coefficients[i] * coefficients[j];
        m_kWanted[first + i] += weight * coefficients[i] * wanted;
    }
}

void CArmFit::AddPull(size_t sample, double weight, const Values& wanted)
{
    for (size_t i = 0; i < kValues; ++i)
    {
        m_kRows[sample * kValues + i][0] += weight * m_kScales[i];
        m_kWanted[sample * kValues + i] += weight * m_kScales[i] * wanted[i];
    }
}

// Leaves D in the first column of the rows and D · U behind it, and applies the elimination to m_kWanted.
void CArmFit::Factor()
{
    for (size_t row = 0; row < m_uiCount; ++row)
    {
        const Row pivot = m_kRows[row];
#pragma GCC unroll 10
        for (size_t below = 1; below < kBand; ++below)
        {
            if (pivot[below] == 0.0)
                continue;
            const double factor = pivot[below] / pivot[0];
            Row& other = m_kRows[row + below];
            for (size_t column = below; column < kBand; ++column)
                other[column - below] -= factor * pivot[column];
            m_kWanted[row + below] -= factor * m_kWanted[row];
        }
    }
}

std::vector<CArmFit::Values> CArmFit::Solve()
{
    Factor();
    std::vector<Values> curves(m_uiCount / kValues);
    for (size_t row = m_uiCount; row-- > 0;)
    {
        for (size_t ahead = 1; ahead < kBand; ++ahead)
            m_kWanted[row] -= m_kRows[row][ahead] * m_kWanted[row + ahead];
        m_kWanted[row] /= m_kRows[row][0];
        curves[row / kValues][row % kValues] = m_kWanted[row];
    }
    return curves;
}

} // namespace gw
