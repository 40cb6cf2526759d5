#include "CWorkerPool.h"

#include "CInterrupt.h"
#include "CSafeFile.h"
#include "Paths.h"
#include "TempFolder.h"

#include <algorithm>
#include <csignal>
#include <gtest/gtest.h>
#include <set>
#include <tuple>
#include <unistd.h>

namespace gw {
namespace {

using EKind = JobEnd::EKind;

enum class EDeed
{
    Good,
    Bad, ///< ends the run, if anything does
    Crash,
    Exit, ///< exits like a program that a sanitizer ends
    Hang,
};

// Each job writes a file with its number and then acts as configured.
class CDeeds : public CJobHandler
{
public:
    CDeeds(std::vector<EDeed> deeds, const CTempFolder& folder, bool goesOn = true)
        : m_kDeeds(std::move(deeds)), folder_(folder), m_bGoesOn(goesOn)
    {
    }

    uint8_t Run(size_t job, std::FILE* record) override
    {
        std::printf("output %zu\n", job);
        std::fprintf(stderr, "words %zu\n", job);
        std::fprintf(record, "record %zu by %d\n", job, getpid());
        std::fflush(nullptr);
        if (job % 3 == 0)
            usleep(20'000); // the first of every three finishes after the others
        Do(m_kDeeds[job]);
        CSafeFile file;
        const bool written =
            file.Open(folder_.Path(std::to_string(job))) && file.Write("result") && file.Commit();
        return written && m_kDeeds[job] != EDeed::Bad ? 1 : 0;
    }

    void Lost(size_t job) override { lost.push_back(job); }

    bool Take(size_t job, const JobEnd& end) override
    {
        EXPECT_EQ(end.output, "output " + std::to_string(job) + '\n');
        EXPECT_EQ(end.words, "words " + std::to_string(job) + '\n');
        processes.push_back(end.record.substr(end.record.find("by")));
        taken.push_back(job);
        kinds.push_back(end.kind);
        good += end.kind == EKind::Ran ? end.answer : 0;
        return m_bGoesOn || (end.kind == EKind::Ran && end.answer == 1);
    }

    std::vector<size_t> taken;
    std::vector<size_t> lost;
    std::vector<EKind> kinds;
    std::vector<std::string> processes;
    size_t good = 0;

private:
    static void Do(EDeed deed)
    {
        if (deed == EDeed::Crash)
            std::raise(SIGKILL);
        if (deed == EDeed::Exit)
            _exit(3);
        while (deed == EDeed::Hang)
            pause();
    }

    std::vector<EDeed> m_kDeeds;
    const CTempFolder& folder_;
    bool m_bGoesOn;
};

std::vector<EDeed> Deeds(size_t count, size_t at, EDeed deed)
{
    std::vector<EDeed> deeds(count, EDeed::Good);
    deeds[at] = deed;
    return deeds;
}

bool RunDeeds(CDeeds& deeds, size_t count, size_t workers, ECommit commit, double limit = 60.0)
{
    const CInterrupt interrupt;
    return CWorkerPool(deeds, {workers, limit, commit}).Run(count, interrupt);
}

size_t ResultCount(const CTempFolder& folder, size_t count)
{
    size_t results = 0;
    for (size_t job = 0; job < count; ++job)
        results += FileExists(folder.Path(std::to_string(job))) ? 1 : 0;
    return results;
}

} // namespace

TEST(CWorkerPool, EndsComeInOrderAndFewProcessesDoManyJobs)
{
    for (const size_t workers : {1u, 2u, 5u})
    {
        SCOPED_TRACE(workers);
        const CTempFolder folder;
        CDeeds deeds(std::vector(20, EDeed::Good), folder);
        EXPECT_TRUE(RunDeeds(deeds, 20, workers, ECommit::AtOnce));
        EXPECT_EQ(deeds.taken.size(), 20u);
        EXPECT_TRUE(std::ranges::is_sorted(deeds.taken));
        EXPECT_EQ(deeds.good, 20u);
        const std::set<std::string> processes(deeds.processes.begin(), deeds.processes.end());
        EXPECT_LE(processes.size(), workers);
    }
}

TEST(CWorkerPool, ALostJobCostsItselfOnly)
{
    const std::tuple<const char*, EDeed, EKind> rows[] = {
        {"a signal", EDeed::Crash, EKind::Died},
        {"a bare exit", EDeed::Exit, EKind::Died},
        {"no end", EDeed::Hang, EKind::TimedOut},
    };
    for (const auto& [what, deed, kind] : rows)
    {
        SCOPED_TRACE(what);
        const CTempFolder folder;
        CDeeds deeds(Deeds(12, 4, deed), folder);
        EXPECT_TRUE(RunDeeds(deeds, 12, 2, ECommit::AtOnce, 2.0));
        EXPECT_EQ(deeds.taken.size(), 12u);
        EXPECT_EQ(deeds.kinds[4], kind);
        EXPECT_EQ(deeds.lost, std::vector<size_t>{4});
        EXPECT_EQ(deeds.good, 11u);
        EXPECT_EQ(ResultCount(folder, 12), 11u);
    }
}

TEST(CWorkerPool, ARunThatEndsLeavesWhatOneByOneLeaves)
{
    for (const EDeed deed : {EDeed::Bad, EDeed::Crash})
    {
        for (const size_t workers : {1u, 2u, 5u})
        {
            SCOPED_TRACE(workers);
            const CTempFolder folder;
            CDeeds deeds(Deeds(20, 6, deed), folder, false);
            EXPECT_TRUE(RunDeeds(deeds, 20, workers, ECommit::InTurn));
            EXPECT_EQ(deeds.taken, (std::vector<size_t>{0, 1, 2, 3, 4, 5, 6}));
            EXPECT_EQ(ResultCount(folder, 20), deed == EDeed::Bad ? 7u : 6u);
        }
    }
}

} // namespace gw
