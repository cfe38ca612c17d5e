#include "EngineTest.h"

namespace {

const Component kPackageEntry{UpdateManager::MainHead, "Marlix IV", "1.4.2", "1.5.0"};
const Component kModuleEntry{UpdateManager::VexaModule, "VEXA", "1.9", "2.0"};
const std::string kFoundPackage = " 0 Marlix IV 1.4.2 -> 1.5.0;";
const std::string kFoundModule = " 1 VEXA 1.9 -> 2.0;";

class MainHeadCheck : public EngineTest, public testing::WithParamInterface<ScenarioRow>
{
};

// druv is stopped before anything else on every path; a check installs nothing.
TEST_P(MainHeadCheck, ReportsOneOutcomeOnTheWorker)
{
    script(GetParam().mirrorsStatus, GetParam().package, GetParam().module);
    engine.init(false);
    const Outcome outcome = waitForOutcomes(1).front();
    EXPECT_EQ(outcome.text, GetParam().outcome);
    EXPECT_NE(outcome.thread, std::this_thread::get_id());
    EXPECT_TRUE(ranInOrder({"systemctl stop druv", "apt update"}));
    EXPECT_EQ(fake.journal().front(), "systemctl stop druv");
    expectJournal(GetParam());
    EXPECT_EQ(runs("apt --assume-yes*") + runs("scp*") + runs(kModuleInstallScript), 0);
}

INSTANTIATE_TEST_SUITE_P(Outcomes, MainHeadCheck, testing::ValuesIn(std::vector<ScenarioRow>{
    {"MirrorsFailWithoutQuery", 100, Package::Due, Module::Due, {}, "UpdateMirrorsFailed", {}, {"apt-cache*", "ssh*"}},
    {"PackageQueryFailsBeforeModule", 0, Package::QueryFails, Module::Due, {}, "CheckUpdateFailed",
     {"apt-cache policy marlix4-dh"}, {"ssh*"}},
    {"PackageDueModuleUnreachable", 0, Package::Due, Module::Unreachable, {}, "CheckUpdateFailed",
     {"apt-cache policy marlix4-dh", kModuleVersionRead}, {"ls*"}},
    {"PackageUpToDateModuleUnreachable", 0, Package::UpToDate, Module::Unreachable, {}, "CheckUpdateFailed", {}, {}},
    {"BothUpToDate", 0, Package::UpToDate, Module::UpToDate, {}, "NoUpdates", {kModuleListing}, {}},
    {"OnlyPackage", 0, Package::Due, Module::UpToDate, {}, "UpdateFound:" + kFoundPackage, {}, {}},
    {"OnlyModule", 0, Package::UpToDate, Module::Due, {}, "UpdateFound:" + kFoundModule, {}, {}},
    {"BothPackageFirst", 0, Package::Due, Module::Due, {}, "UpdateFound:" + kFoundPackage + kFoundModule, {}, {}},
}), RowName());

class MainHeadInstall : public EngineTest, public testing::WithParamInterface<ScenarioRow>
{
};

// No init before: update must start its worker without an earlier one to join.
TEST_P(MainHeadInstall, ReportsOneOutcome)
{
    script(0, GetParam().package, GetParam().module);
    engine.update(GetParam().list, false);
    EXPECT_EQ(waitForOutcomes(1).front().text, GetParam().outcome);
    expectJournal(GetParam());
    EXPECT_TRUE(GetParam().package != Package::InstallFails || logged("100E: Unable to fetch\n"));
}

INSTANTIATE_TEST_SUITE_P(Outcomes, MainHeadInstall, testing::ValuesIn(std::vector<ScenarioRow>{
    {"EmptyListFinishesAtOnce", 0, Package::Due, Module::Due, {}, "UpdateFinished", {}, {"*"}},
    {"UnknownTypeSkipped", 0, Package::Due, Module::Due, {{UpdateManager::ComponentType(7), "?", "", ""}},
     "UpdateFinished", {}, {"*"}},
    {"PackageFailureStopsBeforeModule", 0, Package::InstallFails, Module::Due, {kPackageEntry, kModuleEntry},
     "UpdateFailed", {"apt --assume-yes install marlix4-dh"}, {"apt update", "ls*", "scp*", "ssh*"}},
    {"ModuleUploadFails", 0, Package::Due, Module::UploadFails, {kModuleEntry}, "UpdateVexaFailed", {"scp*"}, {"ssh*"}},
    {"ModuleNotVerified", 0, Package::Due, Module::StaysOld, {kModuleEntry}, "UpdateVexaFailed",
     {"scp*", kModuleInstallScript, "sleep 780", kModuleVersionRead}, {}},
    {"BothInListOrder", 0, Package::Due, Module::Due, {kPackageEntry, kModuleEntry}, "UpdateFinished",
     {"apt --assume-yes install marlix4-dh", "scp*", kModuleInstallScript, "sleep 780", kModuleVersionRead}, {}},
}), RowName());

class RemoteHeadUpdate : public EngineTest, public testing::WithParamInterface<ScenarioRow>
{
};

// Refresh, check and install in one call: the outcome is in before update returns.
TEST_P(RemoteHeadUpdate, ReportsOneOutcomeOnTheCaller)
{
    script(GetParam().mirrorsStatus, GetParam().package, GetParam().module);
    engine.update({kPackageEntry}, true);
    const std::vector<Outcome> outcomes = waitForOutcomes(0);
    ASSERT_EQ(outcomes.size(), 1u);
    EXPECT_EQ(outcomes.front().text, GetParam().outcome);
    EXPECT_EQ(outcomes.front().thread, std::this_thread::get_id());
    expectJournal(GetParam());
    EXPECT_EQ(runs("*marlix4-dh*") + runs("systemctl*"), 0);
}

const std::string kRhInstall = "apt --assume-yes install marlix4-rh";

INSTANTIATE_TEST_SUITE_P(Outcomes, RemoteHeadUpdate, testing::ValuesIn(std::vector<ScenarioRow>{
    {"MirrorsFail", 1, Package::Due, Module::Due, {}, "UpdateMirrorsFailed", {"apt update"}, {"apt-cache*", "ssh*"}},
    {"PackageQueryFails", 0, Package::QueryFails, Module::Due, {}, "CheckUpdateFailed",
     {"apt-cache policy marlix4-rh"}, {"apt --assume-yes*", "ssh*"}},
    {"PackageInstallFails", 0, Package::InstallFails, Module::Due, {}, "UpdateFailed", {kRhInstall}, {"ssh*"}},
    {"ModuleInstallFails", 0, Package::Due, Module::UploadFails, {}, "UpdateVexaFailed", {kRhInstall, "scp*"},
     {kModuleInstallScript}},
    {"OnlyModuleInstalled", 0, Package::UpToDate, Module::Due, {}, "UpdateFinished",
     {kModuleVersionRead, "scp*", kModuleInstallScript, "sleep 780", kModuleVersionRead}, {"apt --assume-yes*"}},
    {"NothingDue", 0, Package::UpToDate, Module::UpToDate, {}, "NoUpdates", {kModuleListing}, {"apt --assume-yes*", "scp*"}},
    {"NothingDueModuleUnreachable", 0, Package::UpToDate, Module::Unreachable, {}, "NoUpdates", {kModuleVersionRead},
     {"apt --assume-yes*"}},
    {"OnlyPackageInstalled", 0, Package::Due, Module::UpToDate, {}, "UpdateFinished", {kRhInstall, kModuleListing},
     {"scp*"}},
    {"PackageInstalledModuleUnreachable", 0, Package::Due, Module::Unreachable, {}, "CheckUpdateFailed",
     {kRhInstall, kModuleVersionRead}, {"scp*"}},
}), RowName());

} // namespace
