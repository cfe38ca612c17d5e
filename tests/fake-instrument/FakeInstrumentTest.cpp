#include "FakeInstrument.h"

#include <gtest/gtest.h>

#include <csignal>
#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <sys/wait.h>

namespace {

struct Call
{
    int status;
    std::string output;
};

Call run(const std::string &command)
{
    Call call{};
    FILE *pipe = popen(command.c_str(), "r");
    char buffer[4096];
    for (std::size_t count; (count = std::fread(buffer, 1, sizeof buffer, pipe)) > 0;)
        call.output.append(buffer, count);
    call.status = pclose(pipe);
    return call;
}

std::string everyByteValue()
{
    std::string bytes;
    for (int value = 0; value < 256; ++value)
        bytes += static_cast<char>(value);
    return bytes;
}

} // namespace

TEST(FakeInstrument, JournalsEachCallWithItsArgumentsJoinedByBlanks)
{
    FakeInstrument fake;
    run("apt-cache policy   marlix4-dh && systemctl && ssh -o A=1 host \" cat f | grep 'x'\"");
    const std::vector<std::string> expected = {"apt-cache policy marlix4-dh", "systemctl",
                                               "ssh -o A=1 host  cat f | grep 'x'"};
    EXPECT_EQ(fake.journal(), expected);
}

TEST(FakeInstrument, PrintsScriptedBytesExactlyAndExitsWithScriptedStatus)
{
    const std::vector<std::string> outputs = {everyByteValue(), "  Installed: 1.0\r\n2.0", "",
                                              std::string(3 << 20, 'x') + "\n" + everyByteValue()};
    for (const std::string &bytes : outputs) {
        FakeInstrument fake;
        fake.answer("apt update", bytes, 100);
        const Call call = run("apt update");
        EXPECT_EQ(call.output, bytes);
        EXPECT_EQ(WEXITSTATUS(call.status), 100);
    }
}

TEST(FakeInstrument, FirstMatchingRuleWithUsesLeftAnswers)
{
    FakeInstrument fake;
    fake.answer("scp *", "failing\n", 1, 2);
    fake.answer("scp *", "copied\n");
    fake.answer("*", "never reached\n", 3);
    std::string answers;
    for (int call = 0; call < 4; ++call) {
        const Call result = run("scp a b");
        answers += result.output + std::to_string(WEXITSTATUS(result.status)) + ";";
    }
    EXPECT_EQ(answers, "failing\n1;failing\n1;copied\n0;copied\n0;");
}

TEST(FakeInstrument, UnscriptedCallPrintsNothingAndSucceeds)
{
    FakeInstrument fake;
    fake.answer("umount *", "busy\n", 32);
    const Call call = run("systemctl stop druv");
    EXPECT_EQ(call.output, "");
    EXPECT_EQ(call.status, 0);
}

TEST(FakeInstrument, EndsByTheScriptedSignal)
{
    FakeInstrument fake;
    fake.endBySignal("ls *", SIGTERM);
    const Call call = run("exec ls /root/USB_MOUNT/");
    ASSERT_TRUE(WIFSIGNALED(call.status));
    EXPECT_EQ(WTERMSIG(call.status), SIGTERM);
}

TEST(FakeInstrument, RecordsTheEnvironmentOfEachCommandWhenAsked)
{
    FakeInstrument fake;
    run("ssh before");
    fake.recordEnvironment();
    setenv("FAKE_INSTRUMENT_SELF_CHECK", "seen", 1);
    run("ssh after");
    unsetenv("FAKE_INSTRUMENT_SELF_CHECK");
    std::ifstream file(fake.scenarioDir() + "/env.ssh");
    const std::string environment{std::istreambuf_iterator<char>(file), {}};
    EXPECT_NE(environment.find("\nFAKE_INSTRUMENT_SELF_CHECK=seen\n"), std::string::npos);
    EXPECT_NE(environment.find("PATH=" + FakeInstrument::binDir() + ":"), std::string::npos);
}

TEST(FakeInstrument, LeavesNoTraceOnceDestroyed)
{
    const std::string pathBefore = std::getenv("PATH");
    std::string scenario;
    {
        FakeInstrument fake;
        scenario = fake.scenarioDir();
        EXPECT_EQ(std::string(std::getenv("FAKE_INSTRUMENT_DIR")), scenario);
    }
    EXPECT_EQ(std::getenv("PATH"), pathBefore);
    EXPECT_EQ(std::getenv("FAKE_INSTRUMENT_DIR"), nullptr);
    EXPECT_FALSE(std::filesystem::exists(scenario));
}

TEST(FakeInstrument, RefusesToRunWithoutAScenario)
{
    const std::string fakeLs = FakeInstrument::binDir() + "/ls";
    const Call call = run(fakeLs + " / 2>/dev/null");
    EXPECT_EQ(call.output, "");
    EXPECT_EQ(WEXITSTATUS(call.status), 127);
}
