#include "EngineTest.h"

#include <future>

namespace {

const Component kPackageEntry{UpdateManager::MainHead, "Marlix IV", "1.4.2", "1.5.0"};
const Component kModuleEntry{UpdateManager::VexaModule, "VEXA", "1.9", "2.0"};
const std::string kFoundPackage = "UpdateFound: 0 Marlix IV 1.4.2 -> 1.5.0;", kFoundModule = " 1 VEXA 1.9 -> 2.0;";
const std::string kRhInstall = "apt --assume-yes install marlix4-rh";
const std::string kDhInstall = "apt --assume-yes install marlix4-dh", kAnyInstall = "apt --assume-yes*";

// The main head checks (init) and installs (update) on a worker; the remote
// head refreshes, checks and installs in one update on the caller's thread.
enum class Phase { Check, Install, Remote };

// One row of an outcome table: the instrument, what the engine must report,
// and the commands that must have run in this order, and must not have run.
struct ScenarioRow
{
    std::string name;
    Phase phase;
    int mirrorsStatus;
    Package package;
    Module module;
    std::vector<Component> list;
    std::string outcome;
    std::vector<std::string> ran, notRan;
};

struct OutcomeTable : EngineTest, testing::WithParamInterface<ScenarioRow> {};

TEST_P(OutcomeTable, ReportsExactlyOneOutcome)
{
    const ScenarioRow &row = GetParam();
    script(row.mirrorsStatus, row.package, row.module);
    // No init before an install: update must start its worker without an earlier one to join.
    row.phase == Phase::Check ? engine.init(false) : engine.update(row.list, row.phase == Phase::Remote);
    const Outcomes outcomes = waitForOutcomes(row.phase == Phase::Remote ? 0 : 1);
    ASSERT_EQ(outcomes.size(), 1u);
    EXPECT_EQ(outcomes.front().first, row.outcome);
    EXPECT_EQ(outcomes.front().second == std::this_thread::get_id(), row.phase == Phase::Remote);
    EXPECT_TRUE(ranInOrder(row.ran)) << testing::PrintToString(fake.journal());
    for (const std::string &glob : row.notRan)
        EXPECT_EQ(runs(glob), 0) << glob;
    // druv is stopped before anything else on every check path; a check installs nothing.
    EXPECT_TRUE(row.phase != Phase::Check
                || (fake.journal().front() == "systemctl stop druv" && runs("apt --assume-yes*") + runs("scp*") == 0));
    EXPECT_TRUE(row.phase != Phase::Remote || runs("*marlix4-dh*") + runs("systemctl*") == 0);
    // The log tells an unreachable index (100) from any other failed refresh.
    const std::string refreshWords = row.mirrorsStatus == 0 ? "OK"
                                     : row.mirrorsStatus == 100 ? "NO_INTERNET_ERROR_CODE"
                                                                : "NOT OK " + std::to_string(row.mirrorsStatus);
    EXPECT_EQ(logged(refreshWords), row.phase != Phase::Install) << refreshWords;
    EXPECT_EQ(logged("100E: Unable to fetch\n"), runs("apt --assume-yes*") && row.package == Package::InstallFails);
    // The install script's status is logged, not judged: the fresh version read decides.
    EXPECT_EQ(logged("Install script ended with code: 65280"), runs(kInstallScript) == 1);
}

using P = Package;
using M = Module;
const auto kCheck = Phase::Check, kInstall = Phase::Install, kRemote = Phase::Remote;

INSTANTIATE_TEST_SUITE_P(Outcomes, OutcomeTable, testing::ValuesIn(std::vector<ScenarioRow>{
    {"CheckMirrorsFailWithoutQuery", kCheck, 100, P::Due, M::Due, {}, "UpdateMirrorsFailed", {"apt update"},
     {"apt-cache*", "ssh*"}},
    {"CheckPackageQueryFailsBeforeModule", kCheck, 0, P::QueryFails, M::Due, {}, "CheckUpdateFailed",
     {"apt update", "apt-cache policy marlix4-dh"}, {"ssh*"}},
    {"CheckPackageDueModuleUnreachable", kCheck, 0, P::Due, M::Unreachable, {}, "CheckUpdateFailed",
     {"apt-cache policy marlix4-dh", kVersionRead}, {"ls*"}},
    {"CheckPackageUpToDateModuleUnreachable", kCheck, 0, P::UpToDate, M::Unreachable, {}, "CheckUpdateFailed", {}, {}},
    {"CheckBothUpToDate", kCheck, 0, P::UpToDate, M::UpToDate, {}, "NoUpdates", {kListing}, {}},
    {"CheckOnlyPackage", kCheck, 0, P::Due, M::UpToDate, {}, kFoundPackage, {}, {}},
    {"CheckOnlyModule", kCheck, 0, P::UpToDate, M::Due, {}, "UpdateFound:" + kFoundModule, {}, {}},
    {"CheckBothPackageFirst", kCheck, 0, P::Due, M::Due, {}, kFoundPackage + kFoundModule, {}, {}},
    {"InstallEmptyListFinishesAtOnce", kInstall, 0, P::Due, M::Due, {}, "UpdateFinished", {}, {"*"}},
    {"InstallUnknownTypeSkipped", kInstall, 0, P::Due, M::Due, {{UpdateManager::ComponentType(7), "?", "", ""}},
     "UpdateFinished", {}, {"*"}},
    {"InstallPackageFailureStopsBeforeModule", kInstall, 0, P::InstallFails, M::Due, {kPackageEntry, kModuleEntry},
     "UpdateFailed", {kDhInstall}, {"apt update", "ls*", "scp*", "ssh*"}},
    {"InstallModuleUploadFails", kInstall, 0, P::Due, M::UploadFails, {kModuleEntry}, "UpdateVexaFailed", {"scp*"},
     {"ssh*"}},
    {"InstallModuleNotVerified", kInstall, 0, P::Due, M::StaysOld, {kModuleEntry}, "UpdateVexaFailed",
     {"scp*", kInstallScript, "sleep 780", kVersionRead}, {}},
    {"InstallBothInListOrder", kInstall, 0, P::Due, M::Due, {kPackageEntry, kModuleEntry}, "UpdateFinished",
     {kDhInstall, "scp*", kInstallScript, "sleep 780", kVersionRead}, {}},
    {"RemoteMirrorsFail", kRemote, 1, P::Due, M::Due, {}, "UpdateMirrorsFailed", {"apt update"},
     {"apt-cache*", "ssh*"}},
    {"RemotePackageQueryFails", kRemote, 0, P::QueryFails, M::Due, {}, "CheckUpdateFailed",
     {"apt-cache policy marlix4-rh"}, {kAnyInstall, "ssh*"}},
    {"RemotePackageInstallFails", kRemote, 0, P::InstallFails, M::Due, {}, "UpdateFailed", {kRhInstall}, {"ssh*"}},
    {"RemoteModuleInstallFails", kRemote, 0, P::Due, M::UploadFails, {}, "UpdateVexaFailed", {kRhInstall, "scp*"},
     {kInstallScript}},
    {"RemoteOnlyModuleInstalled", kRemote, 0, P::UpToDate, M::Due, {}, "UpdateFinished",
     {kVersionRead, "scp*", kInstallScript, "sleep 780", kVersionRead}, {kAnyInstall}},
    {"RemoteNothingDue", kRemote, 0, P::UpToDate, M::UpToDate, {}, "NoUpdates", {kListing}, {kAnyInstall, "scp*"}},
    {"RemoteNothingDueModuleUnreachable", kRemote, 0, P::UpToDate, M::Unreachable, {}, "NoUpdates",
     {kVersionRead}, {kAnyInstall}},
    {"RemoteOnlyPackageInstalled", kRemote, 0, P::Due, M::UpToDate, {}, "UpdateFinished", {kRhInstall, kListing},
     {"scp*"}},
    {"RemotePackageInstalledModuleUnreachable", kRemote, 0, P::Due, M::Unreachable, {}, "CheckUpdateFailed",
     {kRhInstall, kVersionRead}, {"scp*"}},
}), [](const auto &info) { return info.param.name; });

const std::vector<std::string> kWindDown = {"umount /root/USB_MOUNT/", "systemctl start druv", "sleep 10",
                                            "systemctl stop druv-updater"};

using Lifecycle = EngineTest;

// The drive goes before druv starts; the updater stops its own service last.
// The remote head also stops druv at init, and waits once more at deinit.
TEST_F(Lifecycle, WindDownUnmountsStartsDruvWaitsTenSecondsThenStopsUpdater)
{
    fake.answer("umount *", "", 32); // the drive was already unmounted
    fake.answer("systemctl stop druv", "", 1);
    engine.deinit(false);
    waitForWindDown();
    EXPECT_EQ(fake.journal(), kWindDown);
    EXPECT_TRUE(logged("8192"));
    engine.init(true);
    EXPECT_TRUE(logged("256"));
    engine.deinit(true);
    std::vector<std::string> expected = kWindDown;
    expected.insert(expected.end(), {"systemctl stop druv", "sleep 10"});
    expected.insert(expected.end(), kWindDown.begin(), kWindDown.end());
    EXPECT_EQ(fake.journal(), expected);
    EXPECT_TRUE(waitForOutcomes(0).empty());
}

TEST_F(Lifecycle, UpdateWaitsUntilTheCheckHasEnded)
{
    script(0, Package::Due, Module::UpToDate);
    callbackGate.lock();
    engine.init(false);
    waitForOutcomes(1);
    auto updating = std::async(std::launch::async, [&] { engine.update({kPackageEntry}, false); });
    EXPECT_EQ(updating.wait_for(std::chrono::milliseconds(300)), std::future_status::timeout);
    callbackGate.unlock();
    updating.get();
    EXPECT_EQ(waitForOutcomes(2).back().first, "UpdateFinished");
    EXPECT_TRUE(ranInOrder({"apt-cache policy marlix4-dh", kListing, "apt --assume-yes install marlix4-dh"}));
}

// A second init or an early deinit starts its worker beside the running check.
TEST_F(Lifecycle, OverlappingPhasesAllRunToTheirEnd)
{
    script(0, Package::UpToDate, Module::UpToDate);
    engine.init(false);
    engine.init(false);
    engine.deinit(false);
    const Outcomes outcomes = waitForOutcomes(2);
    EXPECT_EQ(outcomes[0].first + outcomes[1].first, "NoUpdatesNoUpdates");
    waitForWindDown();
    EXPECT_EQ(runs("apt update"), 2);
    EXPECT_TRUE(ranInOrder({"umount /root/USB_MOUNT/", "systemctl start druv", "systemctl stop druv-updater"}));
}

// The dying child keeps the fake instrument first on PATH: should the engine go
// on instead of aborting, its commands still never reach the host.
using LifecycleDeathTest = EngineTest;

TEST_F(LifecycleDeathTest, NullCallbackAbortsEveryLifecycleCall)
{
    GTEST_FLAG_SET(death_test_style, "threadsafe");
    const auto result = +[](UpdateManager::Result) {};
    const auto error = +[](UpdateManager::Error) {};
    const auto found = +[](std::vector<Component>) {};
    const char *const report = "Assertion `validateCallbacks\\(\\)' failed\\.";
    EXPECT_DEATH((engine.setCallbacks(nullptr, error, found), engine.init(false)), report);
    EXPECT_DEATH((engine.setCallbacks(result, nullptr, found), engine.update({}, true)), report);
    EXPECT_DEATH((engine.setCallbacks(result, error, nullptr), engine.deinit(false)), report);
}

} // namespace
