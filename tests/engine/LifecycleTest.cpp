#include "EngineTest.h"

#include <pthread.h>

#include <atomic>
#include <csignal>
#include <cstdlib>
#include <future>

namespace {

const std::vector<std::string> kWindDown = {"umount /root/USB_MOUNT/", "systemctl start druv", "sleep 10",
                                            "systemctl stop druv-updater"};

using Lifecycle = EngineTest;

// The drive goes before druv starts; the updater stops its own service last.
TEST_F(Lifecycle, WindDownUnmountsStartsDruvWaitsTenSecondsThenStopsUpdater)
{
    fake.answer("umount *", "", 32); // the drive was already unmounted
    engine.deinit(false);
    waitForWindDown();
    EXPECT_EQ(fake.journal(), kWindDown);
    EXPECT_TRUE(logged("8192"));
    EXPECT_TRUE(waitForOutcomes(0).empty());
}

TEST_F(Lifecycle, RemoteHeadStopsDruvAtInitAndWaitsTwiceAtDeinit)
{
    fake.answer("systemctl stop druv", "", 1);
    engine.init(true);
    EXPECT_TRUE(logged("256"));
    engine.deinit(true);
    std::vector<std::string> expected = {"systemctl stop druv", "sleep 10"};
    expected.insert(expected.end(), kWindDown.begin(), kWindDown.end());
    EXPECT_EQ(fake.journal(), expected);
    EXPECT_TRUE(waitForOutcomes(0).empty());
}

TEST_F(Lifecycle, UpdateWaitsUntilTheCheckHasEnded)
{
    script(0, Package::Due, Module::UpToDate);
    holdCallbacks(true);
    engine.init(false);
    waitForOutcomes(1);
    auto updating = std::async(std::launch::async, [&] { engine.update({{UpdateManager::MainHead, "", "", ""}}, false); });
    EXPECT_EQ(updating.wait_for(std::chrono::milliseconds(300)), std::future_status::timeout);
    holdCallbacks(false);
    updating.get();
    EXPECT_EQ(waitForOutcomes(2).back().text, "UpdateFinished");
    EXPECT_TRUE(ranInOrder({"apt-cache policy marlix4-dh", kModuleListing, "apt --assume-yes install marlix4-dh"}));
}

// A second init or an early deinit starts its worker beside the running check.
TEST_F(Lifecycle, OverlappingPhasesAllRunToTheirEnd)
{
    script(0, Package::UpToDate, Module::UpToDate);
    engine.init(false);
    engine.init(false);
    engine.deinit(false);
    const std::vector<Outcome> outcomes = waitForOutcomes(2);
    EXPECT_EQ(outcomes[0].text + outcomes[1].text, "NoUpdatesNoUpdates");
    waitForWindDown();
    EXPECT_EQ(runs("apt update"), 2);
    EXPECT_TRUE(ranInOrder({"umount /root/USB_MOUNT/", "systemctl start druv", "systemctl stop druv-updater"}));
}

std::atomic<int> signalsCaught{0};

extern "C" void countSignal(int)
{
    ++signalsCaught;
}

TEST(FixedWaitSleeper, SleepsTheWholeDurationThroughSignals)
{
    // The handler stays: a signal still on its way must not end the program.
    struct sigaction counting{};
    counting.sa_handler = countSignal;
    sigaction(SIGUSR1, &counting, nullptr);
    const pthread_t sleeper = pthread_self();
    std::atomic<bool> awake{false};
    std::thread interrupter([&] {
        for (; !awake; std::this_thread::sleep_for(std::chrono::milliseconds(20)))
            pthread_kill(sleeper, SIGUSR1);
    });
    const auto start = std::chrono::steady_clock::now();
    FixedWait::sleepUninterrupted(std::chrono::milliseconds(300));
    const auto slept = std::chrono::steady_clock::now() - start;
    awake = true;
    interrupter.join();
    EXPECT_GE(slept, std::chrono::milliseconds(300));
    EXPECT_GE(signalsCaught.load(), 1);
}

// Runs in the dying child only: should the engine go on instead of aborting,
// its commands find nothing but the fake, which refuses to run without a scenario.
void keepAwayFromHost()
{
    setenv("PATH", FakeInstrument::binDir().c_str(), 1);
    unsetenv("FAKE_INSTRUMENT_DIR");
}

TEST(LifecycleDeathTest, NullCallbackAbortsEveryLifecycleCall)
{
    GTEST_FLAG_SET(death_test_style, "threadsafe");
    UpdateManager &engine = *UpdateManager::instance();
    const auto result = +[](UpdateManager::Result) {};
    const auto error = +[](UpdateManager::Error) {};
    const auto found = +[](std::vector<Component>) {};
    const char *const report = "Assertion `validateCallbacks\\(\\)' failed\\.";
    EXPECT_DEATH((keepAwayFromHost(), engine.setCallbacks(nullptr, error, found), engine.init(false)), report);
    EXPECT_DEATH((keepAwayFromHost(), engine.setCallbacks(result, nullptr, found), engine.update({}, true)), report);
    EXPECT_DEATH((keepAwayFromHost(), engine.setCallbacks(result, error, nullptr), engine.deinit(false)), report);
}

} // namespace
