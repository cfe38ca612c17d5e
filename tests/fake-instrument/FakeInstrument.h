#pragma once

#include <optional>
#include <string>
#include <vector>

// A scripted instrument for tests: while an object lives, the commands the
// engine runs (apt, apt-cache, systemctl, umount, ssh, scp, ls) resolve to the
// fake in binDir(), which journals every call and answers as scripted here.
// Not thread-safe: script the answers before the engine's worker starts.
class FakeInstrument
{
public:
    static constexpr int unlimited = -1;

    // Makes a fresh scenario directory, puts binDir() first on PATH and points
    // FAKE_INSTRUMENT_DIR at the scenario.
    FakeInstrument();
    // Restores PATH and FAKE_INSTRUMENT_DIR and removes the scenario.
    ~FakeInstrument();
    FakeInstrument(const FakeInstrument &) = delete;
    FakeInstrument &operator=(const FakeInstrument &) = delete;

    // Calls whose journal line matches `glob` print `stdoutBytes` exactly and
    // exit with `exitStatus`, for `uses` calls. Rules are tried in the order
    // they were added; a call no rule answers prints nothing and exits 0.
    void answer(const std::string &glob, const std::string &stdoutBytes, int exitStatus = 0,
                int uses = unlimited);
    // Calls matching `glob` end by `signal`.
    void endBySignal(const std::string &glob, int signal);
    // From now on each call writes its environment to scenarioDir()/env.<name>.
    void recordEnvironment();

    // Every call so far, oldest first: the name and arguments joined by blanks.
    std::vector<std::string> journal() const;
    const std::string &scenarioDir() const;
    static std::string binDir();

private:
    std::string addRule(const std::string &glob, int exitStatus, int uses);

    std::string mScenarioDir;
    int mRuleCount = 0;
    std::optional<std::string> mPreviousPath;
    std::optional<std::string> mPreviousScenario;
};
