#include "EngineTest.h"
#include "UpdaterLog.h"

#include <fcntl.h>
#include <sys/resource.h>
#include <unistd.h>

#include <csignal>
#include <cstring>
#include <ctime>
#include <sstream>

namespace {

std::string localTimestamp()
{
    const std::time_t now = std::time(nullptr);
    std::tm local{};
    char text[32];
    std::strftime(text, sizeof text, "%d-%m-%Y %H-%M-%S", localtime_r(&now, &local));
    return text;
}

std::string idText(std::thread::id id)
{
    return (std::ostringstream() << id).str();
}

using EngineLog = EngineTest;

TEST_F(EngineLog, EntryIsHeaderWithTabSeparatedFieldsThenMessageAfterThreeTabs)
{
    const std::string before = localTimestamp();
    UPDATER_LOG("Running command: ", "apt update", " ", 100); const int line = __LINE__;
    UPDATER_LOG();
    const std::string text = log(), stamp = text.substr(10, 19);
    EXPECT_TRUE(stamp == before || stamp == localTimestamp()) << stamp;
    const std::string header = "Updater | " + stamp + "\t" + idText(std::this_thread::get_id()) + "\tEngineLogTest.cpp:";
    const std::string function = std::string("\t") + __PRETTY_FUNCTION__ + "\n\t\t\t";
    EXPECT_EQ(text, header + std::to_string(line) + function + "Running command: apt update 100\n" + header
                        + std::to_string(line + 1) + function + "\n");
}

TEST_F(EngineLog, EntriesOfTwoThreadsStayWhole)
{
    auto writer = [](int number) {
        for (int entry = 0; entry < 300; ++entry)
            UPDATER_LOG("writer ", number);
    };
    std::thread first(writer, 1), second(writer, 2);
    const std::string ids[] = {"", "\t" + idText(first.get_id()) + "\t", "\t" + idText(second.get_id()) + "\t"};
    first.join();
    second.join();
    std::istringstream text(log());
    int entries = 0;
    for (std::string header, message; std::getline(text, header) && std::getline(text, message); ++entries) {
        ASSERT_TRUE(message == "\t\t\twriter 1" || message == "\t\t\twriter 2") << message;
        EXPECT_EQ(header.rfind("Updater | ", 0), 0u) << header;
        EXPECT_NE(header.find(ids[message.back() - '0']), std::string::npos) << header;
    }
    EXPECT_EQ(entries, 600);
}

using CommandRunner = EngineTest;

TEST_F(CommandRunner, HandsOverEverythingPrintedUnchanged)
{
    std::string everyByte;
    for (int value = 0; value < 256; ++value)
        everyByte += static_cast<char>(value);
    for (const std::string &printed : {std::string(), std::string(5000, 'v') + "\n", std::string("no final newline"),
                                       std::string("a\r\nb\r\n"), everyByte, std::string(3 << 20, '\xff')}) {
        fake.answer("ls *", printed, 0, 1);
        std::string output = "stale";
        EXPECT_EQ(UpdateManager::runProcess("ls /root/USB_MOUNT/", output), 0);
        EXPECT_TRUE(output == printed) << printed.size() << " bytes printed, " << output.size() << " handed over";
    }
}

TEST_F(CommandRunner, ReturnsTheExitStatusOrSignalAndLogsIt)
{
    fake.endBySignal("ls *", SIGTERM);
    for (const int status : {0, 1, 100}) {
        fake.answer("apt update", "", status, 1);
        std::string output;
        EXPECT_EQ(UpdateManager::runProcess("apt update", output), status);
        EXPECT_TRUE(logged("Exit code:" + std::to_string(status))) << status;
    }
    std::string output;
    EXPECT_EQ(UpdateManager::runProcess("exec ls /root/USB_MOUNT/", output), 128 + SIGTERM);
    EXPECT_TRUE(logged("Command ended by signal 15") && logged("Exit code:143"));
}

TEST_F(CommandRunner, CommandThatCannotStartIsAFailure)
{
    // With every file descriptor taken, no pipe can be opened.
    rlimit previous{};
    getrlimit(RLIMIT_NOFILE, &previous);
    const rlimit tight{64, previous.rlim_max};
    setrlimit(RLIMIT_NOFILE, &tight);
    std::vector<int> taken;
    for (int fd; (fd = open("/dev/null", O_RDONLY)) >= 0;)
        taken.push_back(fd);
    std::string output = "stale";
    const int exitCode = UpdateManager::runProcess("ls /root/USB_MOUNT/", output);
    for (const int fd : taken)
        close(fd);
    setrlimit(RLIMIT_NOFILE, &previous);

    EXPECT_EQ(exitCode, -1);
    EXPECT_EQ(output, "");
    EXPECT_TRUE(logged("Could not start command: ls /root/USB_MOUNT/ (" + std::string(std::strerror(EMFILE)) + ")"));
    EXPECT_EQ(log().find("Exit code:"), std::string::npos);
}

TEST_F(CommandRunner, UncollectableExitStatusIsAFailure)
{
    // With SIGCHLD ignored the kernel reaps the command, leaving pclose nothing to collect.
    struct sigaction ignore{}, previous{};
    ignore.sa_handler = SIG_IGN;
    sigaction(SIGCHLD, &ignore, &previous);
    std::string output;
    const int exitCode = UpdateManager::runProcess("ls /root/USB_MOUNT/", output);
    sigaction(SIGCHLD, &previous, nullptr);

    EXPECT_EQ(exitCode, -1);
    EXPECT_TRUE(logged("Could not collect the exit status of: ls /root/USB_MOUNT/ (" + std::string(std::strerror(ECHILD)) + ")"));
    EXPECT_TRUE(logged("Exit code:-1"));
}

} // namespace
