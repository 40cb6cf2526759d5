// The sum of squares has its least where its derivatives vanish, which is one linear equation a frame. A
// frame's equation contains the two frames before and the two after it: the matrix is symmetric, positive
// definite and has five diagonals. It is factored as L · D · transpose(L) from the top down (Golub and Van
// Loan, Matrix Computations, banded Cholesky), with no choice of pivots and without a square root.
//
// For a curve asked for everywhere with weight 1, a bend of b multiplies what swings with w radians a frame
// by 1 / (1 + b w^4): BendWeight is the b at which that is a half.

#include "CBandFit.h"

#include "Angles.h"

#include <cmath>

namespace gw {

CBandFit::CBandFit(size_t frameCount, double bend, double rest)
    : m_kDiagonal(frameCount, rest), m_kNext(frameCount, 0.0), m_kAfterNext(frameCount, 0.0),
      m_kWanted(frameCount, 0.0)
{
    for (size_t frame = 0; frame + 2 < frameCount; ++frame)
        AddBend(frame, bend);
}

void CBandFit::AddBend(size_t frame, double weight)
{
    m_kDiagonal[frame] += weight;
    m_kDiagonal[frame + 1] += 4.0 * weight;
    m_kDiagonal[frame + 2] += weight;
    m_kNext[frame] -= 2.0 * weight;
    m_kNext[frame + 1] -= 2.0 * weight;
    m_kAfterNext[frame] += weight;
}

void CBandFit::AddValue(size_t frame, double weight, double wanted)
{
    if (!std::isfinite(weight * wanted))
        return;
    m_kDiagonal[frame] += weight;
    m_kWanted[frame] += weight * wanted;
}

void CBandFit::AddStep(size_t frame, double weight, double wanted)
{
    if (!std::isfinite(weight * wanted))
        return;
    m_kDiagonal[frame] += weight;
    m_kDiagonal[frame + 1] += weight;
    m_kNext[frame] -= weight;
    m_kWanted[frame] -= weight * wanted;
    m_kWanted[frame + 1] += weight * wanted;
}

// Leaves D in the diagonal and the two diagonals of L below it in the others.
void CBandFit::Factor()
{
    for (size_t frame = 0; frame < m_kDiagonal.size(); ++frame)
    {
        const double pivot = m_kDiagonal[frame];
        const double next = m_kNext[frame] / pivot;
        const double afterNext = m_kAfterNext[frame] / pivot;
        if (frame + 1 < m_kDiagonal.size())
        {
            m_kDiagonal[frame + 1] -= next * m_kNext[frame];
            m_kNext[frame + 1] -= next * m_kAfterNext[frame];
        }
        if (frame + 2 < m_kDiagonal.size())
            m_kDiagonal[frame + 2] -= afterNext * m_kAfterNext[frame];
        m_kNext[frame] = next;
        m_kAfterNext[frame] = afterNext;
    }
}

std::vector<double> CBandFit::Solve()
{
    Factor();
    std::vector<double> curve = std::move(m_kWanted);
    const size_t count = curve.size();
    for (size_t frame = 0; frame < count; ++frame)
    {
        if (frame >= 1)
            curve[frame] -= m_kNext[frame - 1] * curve[frame - 1];
        if (frame >= 2)
            curve[frame] -= m_kAfterNext[frame - 2] * curve[frame - 2];
    }
    for (size_t frame = count; frame-- > 0;)
    {
        curve[frame] /= m_kDiagonal[frame];
        if (frame + 1 < count)
            curve[frame] -= m_kNext[frame] * curve[frame + 1];
        if (frame + 2 < count)
            curve[frame] -= m_kAfterNext[frame] * curve[frame + 2];
    }
    return curve;
}

double BendWeight(double hertz, double secondsPerFrame)
{
    return std::pow(kTwoPi64 * hertz * secondsPerFrame, -4.0);
}

} // namespace gw
