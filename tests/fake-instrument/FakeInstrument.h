#pragma once

#include <optional>
#include <string>
#include <vector>

// A scripted instrument for tests: while an object lives, binDir() is first on
// PATH, so the commands the engine runs (apt, apt-cache, systemctl, umount,
// ssh, scp, ls) reach the fake, which journals every call and answers as
// scripted here. Script the answers before the engine's worker starts.
class FakeInstrument
{
public:
    static constexpr int unlimited = -1;

    FakeInstrument();
    ~FakeInstrument();
    FakeInstrument(const FakeInstrument &) = delete;
    FakeInstrument &operator=(const FakeInstrument &) = delete;

    // Calls whose journal line matches `glob` print `stdoutBytes` exactly and
    // exit with `exitStatus`, for `uses` calls. Rules are tried in the order
    // they were added; a call no rule answers prints nothing and exits 0.
    void answer(const std::string &glob, const std::string &stdoutBytes, int exitStatus = 0, int uses = unlimited);
    void endBySignal(const std::string &glob, int signal);
    // From now on each call writes its environment to scenarioDir()/env.<name>.
    void recordEnvironment();

    // Every call so far, oldest first: the name and arguments joined by blanks.
    std::vector<std::string> journal() const;
    const std::string &scenarioDir() const { return mScenarioDir; }
    static std::string binDir();

private:
    // Zero-padded names keep the rules in the order they were added.
    std::string lastRule() const { return mScenarioDir + "/rules/" + std::to_string(10000 + mRuleCount).substr(1); }

    std::string mScenarioDir;
    int mRuleCount = 0;
    std::optional<std::string> mPreviousPath, mPreviousScenario;
};
