// The shared word that counts the running instances.

#include "CInstanceCounter.h"

#include <algorithm>
#include <gtest/gtest.h>
#include <thread>
#include <vector>

#include <fcntl.h>
#include <sys/mman.h>
#include <sys/stat.h>
#include <unistd.h>

namespace gw {
namespace {

// Uses a name of its own, and removes it afterwards.
class InstanceCounter : public testing::Test
{
protected:
    ~InstanceCounter() override { shm_unlink(CInstanceCounter(m_kName).SharedName().c_str()); }

    std::string m_kName = "gaitwright-test-" + std::to_string(getpid());
};

TEST_F(InstanceCounter, CountsTheInstancesThatRun)
{
    CInstanceCounter first(m_kName);
    EXPECT_EQ(first.Value(), -1);
    EXPECT_EQ(first.Enter(), 0);
    CInstanceCounter second(m_kName);
    EXPECT_EQ(second.Enter(), 1);
    EXPECT_EQ(first.Value(), 1);
    first.Reset();
    EXPECT_EQ(first.Value(), -1);
    EXPECT_EQ(first.Enter(), 0);
    EXPECT_EQ(second.Enter(), 1);
    second.Leave();
    EXPECT_EQ(first.Value(), 0);
    first.Leave();
    EXPECT_EQ(second.Enter(), 0);
}

TEST_F(InstanceCounter, GivesEveryInstanceAValueOfItsOwn)
{
    constexpr int kThreads = 8;
    constexpr int kEntries = 2000;
    std::vector<int32_t> values(size_t{kThreads} * kEntries);
    std::vector<std::thread> threads;
    for (size_t thread = 0; thread < kThreads; ++thread)
        threads.emplace_back([&, thread] {
            CInstanceCounter counter(m_kName);
            std::generate_n(values.begin() + static_cast<ptrdiff_t>(thread * kEntries), kEntries,
                            [&] { return counter.Enter(); });
        });
    for (std::thread& thread : threads)
        thread.join();
    std::ranges::sort(values);
    EXPECT_EQ(values.front(), 0);
    EXPECT_EQ(values.back(), kThreads * kEntries - 1);
    EXPECT_EQ(std::ranges::adjacent_find(values), values.end());
}

TEST_F(InstanceCounter, IsOfOneUserAndOneName)
{
    CInstanceCounter counter(m_kName);
    counter.Enter();
    EXPECT_TRUE(counter.SharedName().ends_with('-' + std::to_string(geteuid())));
    const int file = shm_open(counter.SharedName().c_str(), O_RDONLY, 0);
    ASSERT_GE(file, 0);
    struct stat status = {};
    EXPECT_EQ(fstat(file, &status), 0);
    EXPECT_EQ(status.st_mode & 0777u, 0600u);
    close(file);
    EXPECT_EQ(CInstanceCounter(m_kName + "-other").Value(), -1);
}

TEST_F(InstanceCounter, CountsForItselfWhereNothingIsShared)
{
    CInstanceCounter counter("no/such/name");
    EXPECT_EQ(counter.Enter(), 0);
    EXPECT_EQ(counter.Enter(), 1);
    counter.Leave();
    EXPECT_EQ(counter.Value(), 0);
    EXPECT_EQ(CInstanceCounter("no/such/name").Value(), -1);
}

} // namespace
} // namespace gw
