#pragma once

#include "FakeInstrument.h"
#include "FixedWait.h"
#include "UpdateManager.h"

#include <gtest/gtest.h>

#include <string>
#include <thread>
#include <vector>

using Component = UpdateManager::UpdateComponent;

// Journal patterns of the commands that reach the Vexa module and the drive.
inline const std::string kModuleVersionRead = "ssh *version.txt*";
inline const std::string kModuleListing = "ls /root/USB_MOUNT/debs/VEXA/armhf/";
inline const std::string kModuleInstallScript = "ssh */unzipUpgrade.sh";

// The head's package and the Vexa module as a test scripts them.
enum class Package { QueryFails, UpToDate, Due, InstallFails };
enum class Module { UpToDate, Unreachable, Due, UploadFails, StaysOld };

// One row of an outcome table: the instrument, what the engine must report,
// and the commands that must have run in this order, and must not have run.
struct ScenarioRow
{
    std::string name;
    int mirrorsStatus;
    Package package;
    Module module;
    std::vector<Component> list;
    std::string outcome;
    std::vector<std::string> ran;
    std::vector<std::string> notRan;
};

inline void PrintTo(const ScenarioRow &row, std::ostream *out)
{
    *out << row.name;
}

struct RowName
{
    template <typename Row>
    std::string operator()(const testing::TestParamInfo<Row> &info) const { return info.param.name; }
};

// An outcome callback in words ("NoUpdates", "UpdateFound: 1 VEXA 1.9 -> 2.0;")
// and the thread it fired on.
struct Outcome
{
    std::string text;
    std::thread::id thread;
};

// Each test gets a fresh fake instrument, recording callbacks, a fixed-wait
// seam that journals "sleep N" instead of sleeping, and an empty log.
class EngineTest : public testing::Test
{
protected:
    void SetUp() override;
    void TearDown() override;

    void script(int mirrorsStatus, Package package, Module module);
    // The engine never joins its workers: a test waits for what each phase
    // does last. A worker that never gets there ends the program, so that it
    // cannot outlive the fake instrument.
    std::vector<Outcome> waitForOutcomes(std::size_t count);
    void waitForWindDown();
    // While held, a callback blocks after it has been recorded.
    void holdCallbacks(bool hold);

    std::vector<long> waits() const;
    bool ranInOrder(const std::vector<std::string> &globs) const;
    int runs(const std::string &glob) const;
    void expectJournal(const ScenarioRow &row) const;
    static std::string log();
    static bool logged(const std::string &message);

    FakeInstrument fake;
    UpdateManager &engine = *UpdateManager::instance();

private:
    FixedWait::Sleeper mPreviousSleeper = nullptr;
};
