// The sum of squares is smallest where its derivatives vanish, which gives one linear equation per frame. A
// frame's equation involves the two frames before and the two after it, so the matrix is symmetric, positive
// definite and has five diagonals. It is factored as L · D · transpose(L) from the top down (Golub and Van
// Loan, Matrix Computations, banded Cholesky), without pivoting and without square roots.
//
// If every frame has a request with weight 1, a bend weight of b scales an oscillation of w radians per frame
// by 1 / (1 + b w^4). BendWeight returns the b for which that is one half.

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

// Stores D in m_kDiagonal and the two diagonals of L below it in the other two.
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
