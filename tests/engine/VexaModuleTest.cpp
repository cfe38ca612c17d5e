#include "EngineTest.h"

namespace {

std::string uploadCommand(const std::string &archive, const std::string &script)
{
    const std::string scp =
        "scp  -o ServerAliveInterval=4 -o ServerAliveCountMax=10 -o ConnectTimeout=2 -o TCPKeepAlive=yes ";
    return scp + archive + " 192.168.9.2:/root/ && " + scp + script + " 192.168.9.2:/";
}

std::string quotedUpload(const std::string &directory)
{
    const std::string path = "'/root/USB_MOUNT/debs/VEXA/armhf/" + directory;
    return uploadCommand(path + "/OSUpgrade.zip'", path + "/unzipUpgrade.sh'");
}

using ModuleUpload = EngineTest;

TEST_F(ModuleUpload, SucceedsOnThirdAttemptAfterTwoNumberedRetries)
{
    fake.answer(kModuleListing, "2.0\n");
    fake.answer("scp *", "", 1, 2);
    EXPECT_TRUE(UpdateManager::uploadVexaFiles());
    EXPECT_EQ(runs("scp *OSUpgrade.zip*"), 3);
    EXPECT_TRUE(logged("Uploading failed. Trying again. 0") && logged("Uploading failed. Trying again. 1"));
    EXPECT_FALSE(logged("Uploading failed. Trying again. 2"));
}

TEST_F(ModuleUpload, GivesUpAfterTwentyAttemptsWithoutRunningTheInstaller)
{
    fake.answer(kModuleListing, "2.0\n");
    fake.answer("scp *", "", 1);
    EXPECT_FALSE(UpdateManager::installVexaUpdate());
    EXPECT_EQ(runs("scp *OSUpgrade.zip*"), 20);
    EXPECT_TRUE(logged("Uploading failed. Trying again. 19"));
    EXPECT_FALSE(logged("Uploading failed. Trying again. 20"));
    EXPECT_TRUE(logged("Failed to upload VEXA with 20 tries. Closing"));
    EXPECT_TRUE(logged("Failed inside uploadVexaFiles"));
    EXPECT_EQ(runs("ssh*"), 0);
    EXPECT_TRUE(waits().empty());
}

// Listing, its status, the command that must be logged (none: no upload) and
// the archive path scp must receive.
struct ListingRow
{
    std::string name, listing;
    int status;
    std::string command, copiedArchive;
};

void PrintTo(const ListingRow &row, std::ostream *out)
{
    *out << row.name;
}

class UploadedDirectory : public EngineTest, public testing::WithParamInterface<ListingRow>
{
};

// Only the directory the check offers (the first listed) goes to the module,
// whatever characters its name holds.
TEST_P(UploadedDirectory, IsTheOfferedCandidate)
{
    fake.answer(kModuleListing, GetParam().listing, GetParam().status);
    EXPECT_EQ(UpdateManager::uploadVexaFiles(), !GetParam().command.empty());
    EXPECT_EQ(logged("Failed to find VEXA candidate directory"), GetParam().command.empty());
    EXPECT_TRUE(GetParam().command.empty() || logged(GetParam().command)) << log();
    EXPECT_EQ(runs("scp * " + GetParam().copiedArchive + " 192.168.9.2:/root/"), GetParam().command.empty() ? 0 : 1)
        << testing::PrintToString(fake.journal());
}

INSTANTIATE_TEST_SUITE_P(Listings, UploadedDirectory, testing::ValuesIn(std::vector<ListingRow>{
    {"SingleDirectoryKeepsWildcard", "2.0\n", 0,
     uploadCommand("/root/USB_MOUNT/debs/VEXA/armhf/*/OSUpgrade.zip", "/root/USB_MOUNT/debs/VEXA/armhf/*/unzipUpgrade.sh"),
     "*"},
    {"FirstOfSeveral", "2.1\n2.0\n", 0, quotedUpload("2.1"), "/root/USB_MOUNT/debs/VEXA/armhf/2.1/OSUpgrade.zip"},
    {"NameWithShellCharacters", "it's $HOME *\n1.0\n", 0, quotedUpload("it'\\''s $HOME *"),
     "/root/USB_MOUNT/debs/VEXA/armhf/it's [$]HOME [*]/OSUpgrade.zip"},
    {"EmptyListing", "", 0, "", "*"},
    {"ListingFails", "2.0\n", 2, "", "*"},
}), RowName());

using ModuleVerification = EngineTest;

TEST_F(ModuleVerification, ReadsAgainWhileTheModuleReboots)
{
    fake.answer(kModuleVersionRead, "", 255, 3);
    fake.answer(kModuleVersionRead, "Quillowmarsh\t2.0\n");
    fake.answer(kModuleListing, "2.0\n");
    EXPECT_TRUE(UpdateManager::verifyVexa());
    EXPECT_EQ(waits(), (std::vector<long>{5, 5, 5}));
    EXPECT_TRUE(logged("VEXA not verified yet. Trying again. 2"));
    EXPECT_TRUE(logged("VEXA verified: 2.0"));
}

TEST_F(ModuleVerification, FailsAfterTwentyReadsOfTheOldVersion)
{
    fake.answer(kModuleVersionRead, "Quillowmarsh\t1.9\n");
    fake.answer(kModuleListing, "2.0\n");
    EXPECT_FALSE(UpdateManager::verifyVexa());
    EXPECT_EQ(runs(kModuleVersionRead), 20);
    EXPECT_EQ(waits(), std::vector<long>(19, 5));
    EXPECT_TRUE(logged("VEXA not verified yet. Trying again. 18"));
    EXPECT_TRUE(logged("Failed to verify VEXA with 20 reads"));
}

// The script loses its connection when the module reboots: its status is
// logged, not judged; the fresh version read after thirteen minutes decides.
TEST_F(ModuleVerification, InstallIgnoresScriptStatusWaitsThirteenMinutesThenVerifies)
{
    fake.answer(kModuleInstallScript, "", 255);
    fake.answer(kModuleVersionRead, "Quillowmarsh\t2.0\n");
    fake.answer(kModuleListing, "2.0.1\n");
    EXPECT_TRUE(UpdateManager::installVexaUpdate());
    EXPECT_TRUE(logged("Install script ended with code: 65280"));
    EXPECT_EQ(waits(), std::vector<long>{780});
    EXPECT_TRUE(ranInOrder({kModuleListing, "scp*", kModuleInstallScript, "sleep 780", kModuleVersionRead}));
}

} // namespace
