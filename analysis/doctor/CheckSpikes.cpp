// Searches all joints of a file for spikes (FindSpikes) and repairs those of one frame. Longer ones are only
// reported, because the true motion in between is unknown.

#include "CheckSpikes.h"

#include "BVHOutline.h"
#include "CFindings.h"
#include "CRowTable.h"
#include "CheckOffsets.h"
#include "FindSpikes.h"
#include "JointRows.h"
#include "RotationTurns.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <span>
#include <string>

namespace gw {

namespace {

constexpr double kLeastJumpShare = 0.1; // of the reach: 10 cm on a person
constexpr float kMostTurn = 90.0f;      // degrees; angles further apart are two notations of one rotation

class CSpikeCheck
{
public:
    CSpikeCheck(const BVHOutline& outline, CRowTable& table, CFindings& findings)
        : outline_(outline), table_(table), findings_(findings)
    {
    }

    void Run()
    {
        const double least = kLeastJumpShare * SkeletonReach(outline_);
        for (const OutlineJoint& joint : outline_.joints)
        {
            const std::vector<size_t> rotations = RotationColumns(joint);
            if (MayJump(rotations))
                Treat(joint, FindSpikes(RotationsOf(joint, table_)), rotations);
            std::array<size_t, 3> positions{};
            if (PositionColumns(joint, positions) && least > 0.0)
                Treat(joint, FindSpikes(PositionsIn(positions), least), positions);
        }
    }

private:
    // A rotation is never larger than the sum of its angles, and angles are quick to compare. Joints without
    // channels take no bytes in a file, so they must not cost a pass over the rows.
    bool MayJump(const std::vector<size_t>& columns) const
    {
        if (columns.empty())
            return false;
        for (size_t row = 1; row < table_.RowCount(); ++row)
        {
            float turn = 0.0f;
            for (const size_t column : columns)
                turn += std::fabs(table_.At(row, column) - table_.At(row - 1, column));
            if (turn >= static_cast<float>(kLeastSpikeDegrees))
                return true;
        }
        return false;
    }
    std::vector<Vec3> PositionsIn(const std::array<size_t, 3>& columns) const
    {
        std::vector<Vec3> positions;
        positions.reserve(table_.RowCount());
        for (size_t row = 0; row < table_.RowCount(); ++row)
            positions.push_back(PositionIn(table_, row, columns));
        return positions;
    }

    void Treat(const OutlineJoint& joint, const std::vector<Spike>& spikes, std::span<const size_t> columns)
    {
        for (const Spike& spike : spikes)
        {
            const size_t line = table_.LineOf(spike.first);
            if (spike.count > 1)
            {
                findings_.AddUnmended(EFailure::Spike, line, joint.name);
                continue;
            }
            findings_.Add(EFailure::Spike, line, joint.name);
            Mend(joint, spike.first, columns);
        }
    }

    // If the angles on both sides are similar, the pose is interpolated; otherwise the previous one is
    // repeated for a frame.
    void Mend(const OutlineJoint& joint, size_t row, std::span<const size_t> columns)
    {
        const bool rotation = joint.channels[columns[0] - joint.firstColumn] >= 3;
        const auto behind = [&](size_t column) {
            const float before = table_.At(row - 1, column);
            const float value = table_.At(row + 1, column);
            return rotation ? NearestTurn(value, before) : value;
        };
        const bool near = std::ranges::all_of(columns, [&](size_t column) {
            return !rotation || std::fabs(behind(column) - table_.At(row - 1, column)) <= kMostTurn;
        });
        for (const size_t column : columns)
        {
            const float before = table_.At(row - 1, column);
            table_.Mend(row, column, near ? before + 0.5f * (behind(column) - before) : before);
        }
    }

    const BVHOutline& outline_;
    CRowTable& table_;
    CFindings& findings_;
};

} // namespace

void CheckSpikes(const BVHOutline& outline, CRowTable& table, CFindings& findings)
{
    CSpikeCheck(outline, table, findings).Run();
}

} // namespace gw
