#include "EngineTest.h"

namespace {

const std::string kEveryByte = [] {
    std::string bytes;
    for (int value = 0; value < 256; ++value)
        bytes += static_cast<char>(value);
    return bytes;
}();

using PackageIndexRefresh = EngineTest;

TEST_F(PackageIndexRefresh, SucceedsOnlyOnExitCodeZeroAndLogsWhy)
{
    for (const auto &[exitCode, message] : std::vector<std::pair<int, std::string>>{
             {0, "OK"}, {100, "NO_INTERNET_ERROR_CODE"}, {1, "NOT OK 1"}}) {
        fake.answer("apt update", "", exitCode, 1);
        EXPECT_EQ(UpdateManager::updateMirrors(), exitCode == 0) << exitCode;
        EXPECT_TRUE(logged(message)) << message;
    }
}

// What a query printed and how it ended, and what the check makes of it.
struct VersionRow
{
    std::string name, output;
    int exitCode;
    bool due, checkOk;
    std::string installed, candidate, message, listing = "";
    int listingStatus = 0;
    bool skipNoInternetCheck = true;
};

void PrintTo(const VersionRow &row, std::ostream *out)
{
    *out << row.name;
}

class PackageVersions : public EngineTest, public testing::WithParamInterface<VersionRow>
{
};

TEST_P(PackageVersions, AreTheLastKeyedLinesComparedAsText)
{
    const VersionRow &row = GetParam();
    fake.answer("apt-cache policy *", row.output, row.exitCode);
    std::string installed = "stale", candidate = "stale";
    bool checkOk = true;
    EXPECT_EQ(UpdateManager::checkUpdate(row.skipNoInternetCheck, "apt-cache policy marlix4-dh", installed, candidate,
                                         checkOk), row.due);
    EXPECT_EQ(checkOk, row.checkOk);
    EXPECT_EQ(installed, row.installed);
    EXPECT_EQ(candidate, row.candidate);
    EXPECT_TRUE(logged(row.message)) << row.message;
}

const std::string kPolicy = "marlix4-dh:\n  Installed: 1.4.2\n  Candidate: 1.5.0\n  Version table:\n";
const std::string kFound = "NWM_UM_UPDATE_FOUND: 1.4.2 -> 1.5.0", kFailed = "NWM_UM_CHECK_UPDATE_FAILED";

INSTANTIATE_TEST_SUITE_P(Rules, PackageVersions, testing::ValuesIn(std::vector<VersionRow>{
    {"IndentedVersionsDiffer", kPolicy, 0, true, true, "1.4.2", "1.5.0", kFound},
    {"OlderCandidateIsAnUpdate", "Installed: 1.4.2\nCandidate: 1.4.1", 0, true, true, "1.4.2", "1.4.1",
     "NWM_UM_UPDATE_FOUND: 1.4.2 -> 1.4.1"},
    {"LaterLineWinsEqualIsNoUpdate", "  Installed: 1.0\n  Candidate: 1.1\n  Installed: 1.1\n", 0, false, true, "1.1",
     "1.1", "NWM_UM_NO_UPDATES 1.1 == 1.1"},
    {"CarriageReturnsKept", "Installed: 1.0\r\nCandidate: 1.0\r\n", 0, false, true, "1.0\r", "1.0\r",
     "NWM_UM_NO_UPDATES 1.0\r == 1.0\r"},
    {"NothingPrinted", "", 0, false, false, "", "", kFailed},
    {"NoInternetEndsCheck", kPolicy, 100, false, false, "", "", "NO_INTERNET_ERROR_CODE", "", 0, false},
    {"NoInternetSkipped", kPolicy, 100, true, true, "1.4.2", "1.5.0", kFound},
    {"BothKeysOnOneLine", "Installed: 1.0 Candidate: 2.0\n", 0, false, false, "1.0 Candidate: 2.0", "", kFailed},
    {"BlankVersion", "  Installed: \n  Candidate: 2.0\n", 0, false, false, "", "2.0", kFailed},
    {"BinaryBytes", kEveryByte + kEveryByte, 0, false, false, "", "", kFailed},
    {"Megabytes", std::string(3 << 20, 'x') + "\n" + kPolicy, 0, true, true, "1.4.2", "1.5.0", kFound},
}), RowName());

class ModuleVersions : public EngineTest, public testing::WithParamInterface<VersionRow>
{
};

TEST_P(ModuleVersions, AreTheLastTaggedLineAgainstTheFirstListedDirectory)
{
    const VersionRow &row = GetParam();
    fake.answer(kModuleVersionRead, row.output, row.exitCode);
    fake.answer(kModuleListing, row.listing, row.listingStatus);
    std::string installed = "stale", candidate = "stale";
    bool checkOk = true;
    EXPECT_EQ(UpdateManager::checkVexaUpdate(installed, candidate, checkOk), row.due);
    EXPECT_EQ(checkOk, row.checkOk);
    EXPECT_EQ(installed, row.installed);
    EXPECT_EQ(candidate, row.candidate);
    EXPECT_TRUE(logged(row.message)) << row.message;
    EXPECT_EQ(runs(kModuleListing), row.exitCode == 0 ? 1 : 0);
}

const std::string kCheckFailed = "Failed to checkUpdate";

INSTANTIATE_TEST_SUITE_P(Rules, ModuleVersions, testing::ValuesIn(std::vector<VersionRow>{
    {"SameVersionCarriageReturnCut", "Quillowmarsh\t2.0.1\r junk\n", 0, false, true, "2.0.1", "2.0.1",
     "VEXA up to date", "2.0.1"},
    {"CandidateContainsInstalled", "Quillowmarsh\t2.0\n", 0, false, true, "2.0", "2.0.1", "QV 2.0  2.0.1", "2.0.1\n"},
    {"InstalledNotContained", "Quillowmarsh\t2.0.1\n", 0, true, true, "2.0.1", "2.0", "Update found: 2.0.1 -> 2.0",
     "2.0\n"},
    {"LastTaggedLineWithTextAroundTag", "Quillowmarsh\t1.0\nver: Quillowmarsh\t 1.1 beta\nQuillowmarsh 9.9", 0, true,
     true, " 1.1 beta", "2.1", "Quillowmarsh 9.9", "2.1\n2.0\n"},
    {"EmptyListing", "Quillowmarsh\t1.0\n", 0, false, false, "1.0", "", kCheckFailed},
    {"ModuleUnreachable", "", 255, false, false, "", "", kCheckFailed, "2.0\n"},
    {"DirectoryMissing", "Quillowmarsh\t1.0\n", 0, false, false, "1.0", "", "Failed to check candidate VEXA version",
     "", 2},
    {"TagWithoutTabOrBlankVersion", "Quillowmarsh 1.0\nQuillowmarsh\t\r\n", 0, false, false, "", "2.0", kCheckFailed,
     "2.0\n"},
    {"BinaryBytes", kEveryByte, 0, false, false, "", "2.0", kCheckFailed, "2.0\n"},
}), RowName());

} // namespace
