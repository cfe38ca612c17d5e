#include "EngineTest.h"

namespace {

// What the package query (no listing) or the module's version read printed and
// how it ended, and what the check makes of it.
struct VersionRow
{
    std::string name, output;
    int exitCode;
    bool due, checkOk;
    std::string installed, candidate, message, listing = "";
    int listingStatus = 0;
    bool skipNoInternetCheck = true;
};

struct VersionCheck : EngineTest, testing::WithParamInterface<VersionRow> {};

// The package's last keyed lines are compared as text; the module's last
// tagged line must be contained in the first listed directory.
TEST_P(VersionCheck, FollowsTheParsingRules)
{
    const VersionRow &row = GetParam();
    const bool module = row.name.rfind("Module", 0) == 0;
    fake.answer(module ? kVersionRead : "apt-cache policy *", row.output, row.exitCode);
    fake.answer(kListing, row.listing, row.listingStatus);
    std::string installed = "stale", candidate = "stale";
    bool checkOk = !row.checkOk;
    const bool due = module ? UpdateManager::checkVexaUpdate(installed, candidate, checkOk)
                            : UpdateManager::checkUpdate(row.skipNoInternetCheck, "apt-cache policy marlix4-dh",
                                                         installed, candidate, checkOk);
    EXPECT_EQ(std::tie(due, checkOk, installed, candidate),
              std::tie(row.due, row.checkOk, row.installed, row.candidate));
    EXPECT_TRUE(logged(row.message)) << row.message;
    EXPECT_EQ(runs(kListing), module && row.exitCode == 0 ? 1 : 0);
}

const std::string kPolicy = "marlix4-dh:\n  Installed: 1.4.2\n  Candidate: 1.5.0\n  Version table:\n";
const std::string kFound = "NWM_UM_UPDATE_FOUND: 1.4.2 -> 1.5.0", kFailed = "NWM_UM_CHECK_UPDATE_FAILED";
const std::string kCheckFailed = "Failed to checkUpdate";

INSTANTIATE_TEST_SUITE_P(Rules, VersionCheck, testing::ValuesIn(std::vector<VersionRow>{
    {"PackageOlderCandidateIsAnUpdate", "Installed: 1.4.2\nCandidate: 1.4.1", 0, true, true, "1.4.2", "1.4.1",
     "NWM_UM_UPDATE_FOUND: 1.4.2 -> 1.4.1"},
    {"PackageLaterLineWinsEqualIsNoUpdate", "  Installed: 1.0\n  Candidate: 1.1\n  Installed: 1.1\n", 0, false, true,
     "1.1", "1.1", "NWM_UM_NO_UPDATES 1.1 == 1.1"},
    {"PackageCarriageReturnsKept", "Installed: 1.0\r\nCandidate: 1.0\r\n", 0, false, true, "1.0\r", "1.0\r",
     "NWM_UM_NO_UPDATES 1.0\r == 1.0\r"},
    {"PackageNoInternetEndsCheck", kPolicy, 100, false, false, "", "", "NO_INTERNET_ERROR_CODE", "", 0, false},
    {"PackageNoInternetSkipped", kPolicy, 100, true, true, "1.4.2", "1.5.0", kFound},
    {"PackageBlankVersion", "  Installed: \n  Candidate: 2.0\n", 0, false, false, "", "2.0", kFailed},
    {"PackageBinaryBytes", kEveryByte + kEveryByte, 0, false, false, "", "", kFailed},
    {"PackageMegabytes", std::string(3 << 20, 'x') + "\n" + kPolicy, 0, true, true, "1.4.2", "1.5.0", kFound},
    {"ModuleSameVersionCarriageReturnCut", "Quillowmarsh\t2.0.1\r junk\n", 0, false, true, "2.0.1", "2.0.1",
     "VEXA up to date", "2.0.1"},
    {"ModuleCandidateContainsInstalled", "Quillowmarsh\t2.0\n", 0, false, true, "2.0", "2.0.1", "QV 2.0  2.0.1",
     "2.0.1\n"},
    {"ModuleInstalledNotContained", "Quillowmarsh\t2.0.1\n", 0, true, true, "2.0.1", "2.0",
     "Update found: 2.0.1 -> 2.0", "2.0\n"},
    {"ModuleLastTaggedLineWithTextAroundTag", "Quillowmarsh\t1.0\nver: Quillowmarsh\t 1.1 beta\nQuillowmarsh 9.9", 0,
     true, true, " 1.1 beta", "2.1", "Quillowmarsh 9.9", "2.1\n2.0\n"},
    {"ModuleEmptyListing", "Quillowmarsh\t1.0\n", 0, false, false, "1.0", "", kCheckFailed},
    {"ModuleDirectoryMissing", "Quillowmarsh\t1.0\n", 0, false, false, "1.0", "",
     "Failed to check candidate VEXA version", "", 2},
    {"ModuleTagWithoutTabOrBlankVersion", "Quillowmarsh 1.0\nQuillowmarsh\t\r\n", 0, false, false, "", "2.0",
     kCheckFailed, "2.0\n"},
    {"ModuleBinaryBytes", kEveryByte, 0, false, false, "", "2.0", kCheckFailed, "2.0\n"},
}), [](const auto &info) { return info.param.name; });

std::string uploadCommand(const std::string &directory, const std::string &quote)
{
    const std::string scp =
        "scp  -o ServerAliveInterval=4 -o ServerAliveCountMax=10 -o ConnectTimeout=2 -o TCPKeepAlive=yes ";
    const std::string path = quote + "/root/USB_MOUNT/debs/VEXA/armhf/" + directory;
    return scp + path + "/OSUpgrade.zip" + quote + " 192.168.9.2:/root/ && " + scp + path + "/unzipUpgrade.sh" + quote
           + " 192.168.9.2:/";
}

// A module that never gets its files is never asked to install them.
using ModuleUpload = EngineTest;

TEST_F(ModuleUpload, RetriesWithNumberedLinesAndGivesUpAfterTwentyAttempts)
{
    fake.answer(kListing, "2.0\n");
    fake.answer("scp *", "", 1);
    EXPECT_FALSE(UpdateManager::installVexaUpdate());
    EXPECT_EQ(runs("scp *OSUpgrade.zip*"), 20);
    EXPECT_TRUE(logged("Uploading failed. Trying again. 0") && logged("Uploading failed. Trying again. 19"));
    EXPECT_FALSE(logged("Uploading failed. Trying again. 20"));
    EXPECT_TRUE(logged("Failed to upload VEXA with 20 tries. Closing") && logged("Failed inside uploadVexaFiles"));
    EXPECT_EQ(runs("ssh*") + runs("sleep*"), 0);
}

// The listing, its status, the command that must be logged (none: no upload)
// and the archive path scp must receive.
struct ListingRow
{
    std::string name, listing;
    int status;
    std::string command, copiedArchive;
};

struct UploadedDirectory : EngineTest, testing::WithParamInterface<ListingRow> {};

// Only the directory the check offers (the first listed) goes to the module,
// whatever characters its name holds.
TEST_P(UploadedDirectory, IsTheOfferedCandidate)
{
    const ListingRow &row = GetParam();
    fake.answer(kListing, row.listing, row.status);
    EXPECT_EQ(UpdateManager::uploadVexaFiles(), !row.command.empty());
    EXPECT_EQ(logged("Failed to find VEXA candidate directory"), row.command.empty());
    EXPECT_TRUE(row.command.empty() || logged(row.command)) << engineLog();
    EXPECT_EQ(runs("scp * " + row.copiedArchive + " 192.168.9.2:/root/"), row.command.empty() ? 0 : 1)
        << testing::PrintToString(fake.journal());
}

INSTANTIATE_TEST_SUITE_P(Listings, UploadedDirectory, testing::ValuesIn(std::vector<ListingRow>{
    {"SingleDirectoryKeepsWildcard", "2.0\n", 0, uploadCommand("*", ""), "*"},
    {"FirstOfSeveral", "2.1\n2.0\n", 0, uploadCommand("2.1", "'"), "/root/USB_MOUNT/debs/VEXA/armhf/2.1/OSUpgrade.zip"},
    {"NameWithShellCharacters", "it's $HOME *\n1.0\n", 0, uploadCommand("it'\\''s $HOME *", "'"),
     "/root/USB_MOUNT/debs/VEXA/armhf/it's [$]HOME [*]/OSUpgrade.zip"},
    {"EmptyListing", "", 0, "", "*"},
    {"ListingFails", "2.0\n", 2, "", "*"},
}), [](const auto &info) { return info.param.name; });

// After the install script the module reboots: its version is read again,
// every five seconds while it is unreachable or still old, at most twenty times.
using ModuleVerification = EngineTest;

TEST_F(ModuleVerification, ReadsAgainWhileTheModuleRebootsAtMostTwentyTimes)
{
    fake.answer(kListing, "2.0\n");
    fake.answer(kVersionRead, "Quillowmarsh\t1.9\n", 0, 20);
    fake.answer(kVersionRead, "", 255, 3);
    fake.answer(kVersionRead, "Quillowmarsh\t2.0\n");
    EXPECT_FALSE(UpdateManager::verifyVexa());
    EXPECT_EQ(std::make_pair(runs(kVersionRead), runs("sleep 5")), std::make_pair(20, 19));
    EXPECT_TRUE(logged("VEXA not verified yet. Trying again. 18") && logged("Failed to verify VEXA with 20 reads"));
    EXPECT_FALSE(logged("VEXA verified: 2.0"));

    EXPECT_TRUE(UpdateManager::verifyVexa());
    EXPECT_EQ(std::make_pair(runs(kVersionRead), runs("sleep 5")), std::make_pair(24, 22));
    EXPECT_EQ(runs("sleep*"), 22);
    EXPECT_TRUE(logged("VEXA verified: 2.0"));
}

} // namespace
