#include "EngineTest.h"
#include "UpdaterLog.h"

#include <pthread.h>
#include <sys/resource.h>

#include <atomic>
#include <csignal>
#include <cstring>
#include <ctime>
#include <sstream>

namespace {

using EngineLog = EngineTest;

TEST_F(EngineLog, EntryIsHeaderWithTabSeparatedFieldsThenMessageAfterThreeTabs)
{
    const auto localTime = [] {
        const std::time_t now = std::time(nullptr);
        std::tm local{};
        char text[32];
        return std::string(text, std::strftime(text, sizeof text, "%d-%m-%Y %H-%M-%S", localtime_r(&now, &local)));
    };
    const std::string before = localTime();
    UPDATER_LOG("Running command: ", "apt update", " ", 100); const int line = __LINE__;
    UPDATER_LOG();
    const std::string text = engineLog(), stamp = text.substr(10, 19);
    EXPECT_TRUE(stamp == before || stamp == localTime()) << stamp;
    const std::string header =
        "Updater | " + stamp + "\t" + testing::PrintToString(std::this_thread::get_id()) + "\tEngineLogTest.cpp:";
    const std::string function = std::string("\t") + __PRETTY_FUNCTION__ + "\n\t\t\t";
    EXPECT_EQ(text, header + std::to_string(line) + function + "Running command: apt update 100\n" + header
                        + std::to_string(line + 1) + function + "\n");
}

// Each writer logs its own thread id, which its header must carry too.
TEST_F(EngineLog, EntriesOfTwoThreadsStayWhole)
{
    const auto writer = [] {
        for (int entry = 0; entry < 300; ++entry)
            UPDATER_LOG(std::this_thread::get_id());
    };
    std::thread first(writer), second(writer);
    first.join();
    second.join();
    std::istringstream text(engineLog());
    int entries = 0;
    for (std::string header, message; std::getline(text, header) && std::getline(text, message); ++entries) {
        const std::string id = message.substr(3);
        EXPECT_EQ(header.substr(0, 10) + header.substr(29, id.size() + 2) + message.substr(0, 3),
                  "Updater | \t" + id + "\t\t\t\t") << header << message;
    }
    EXPECT_EQ(entries, 600);
}

using CommandRunner = EngineTest;

TEST_F(CommandRunner, HandsOverEverythingPrintedAndTheExitStatusOrSignal)
{
    const std::pair<std::string, int> calls[] = {{"", 0}, {std::string(5000, 'v') + "\n", 1},
        {"no final newline", 100}, {"a\r\nb\r\n", 0}, {kEveryByte, 0}, {std::string(3 << 20, '\xff'), 0}};
    for (const auto &[printed, status] : calls) {
        fake.answer("ls *", printed, status, 1);
        std::string output = "stale";
        EXPECT_EQ(UpdateManager::runProcess("ls /root/USB_MOUNT/", output), status);
        EXPECT_TRUE(output == printed) << printed.size() << " bytes printed, " << output.size() << " handed over";
        EXPECT_TRUE(logged("Exit code:" + std::to_string(status))) << status;
    }
    fake.endBySignal("ls *", SIGTERM);
    std::string output;
    EXPECT_EQ(UpdateManager::runProcess("exec ls /root/USB_MOUNT/", output), 128 + SIGTERM);
    EXPECT_TRUE(logged("Command ended by signal 15") && logged("Exit code:143"));
}

// With no file descriptor allowed no pipe can be opened; with SIGCHLD ignored
// the kernel reaps the command, leaving pclose nothing to collect.
TEST_F(CommandRunner, CommandThatCannotStartOrBeCollectedIsAFailure)
{
    rlimit previous{};
    getrlimit(RLIMIT_NOFILE, &previous);
    const rlimit none{0, previous.rlim_max};
    setrlimit(RLIMIT_NOFILE, &none);
    std::string output = "stale";
    EXPECT_EQ(UpdateManager::runProcess("ls /root/USB_MOUNT/", output), -1);
    setrlimit(RLIMIT_NOFILE, &previous);
    EXPECT_EQ(output, "");
    EXPECT_TRUE(logged("Could not start command: ls /root/USB_MOUNT/ (" + std::string(strerror(EMFILE)) + ")"));
    EXPECT_EQ(engineLog().find("Exit code:"), std::string::npos);

    std::signal(SIGCHLD, SIG_IGN);
    EXPECT_EQ(UpdateManager::runProcess("ls /root/USB_MOUNT/", output), -1);
    std::signal(SIGCHLD, SIG_DFL);
    EXPECT_TRUE(logged("Could not collect the exit status of: ls /root/USB_MOUNT/ (" + std::string(strerror(ECHILD))
                       + ")"));
    EXPECT_TRUE(logged("Exit code:-1"));
}

std::atomic<int> signalsCaught{0};

// The handler stays: a signal still on its way must not end the program.
TEST(FixedWaitSleeper, SleepsTheWholeDurationThroughSignals)
{
    std::signal(SIGUSR1, [](int) { ++signalsCaught; });
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

} // namespace
