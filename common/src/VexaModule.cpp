#include "FixedWait.h"
#include "TextLines.h"
#include "UpdateManager.h"
#include "UpdaterLog.h"

#include <cstdlib>

namespace {

// The module is reached without user, password or key options: the access
// is set up on the instrument. The keep-alive options let a copy or the
// install script notice a module that went away.
const std::string kScp =
    "scp  -o ServerAliveInterval=4 -o ServerAliveCountMax=10 -o ConnectTimeout=2 -o TCPKeepAlive=yes ";
const std::string kDriveVexaDirectory = "/root/USB_MOUNT/debs/VEXA/armhf/";

// The version line on the module: the tag, one TAB, the version.
const std::string kVersionTag = "Quillowmarsh\t";

constexpr int kUploadAttempts = 20;
constexpr int kVerifyReads = 20;

// Lists the module versions on the drive; each directory is one version.
int listDriveVersions(std::string &listing)
{
    static const std::string command = "ls /root/USB_MOUNT/debs/VEXA/armhf/";
    return UpdateManager::runProcess(command, listing);
}

// Single quotes keep every character of a directory name literal for the
// shell; an embedded quote closes, escapes and reopens the quoting.
std::string shellQuoted(const std::string &text)
{
    std::string quoted = "'";
    for (char c : text) {
        if (c == '\'')
            quoted += "'\\''";
        else
            quoted += c;
    }
    return quoted + "'";
}

// With a single version on the drive the wildcard names exactly its files.
// With several it would copy every version's files onto the same two paths,
// so only the directory that the check offered is copied.
std::string uploadCommandFor(const std::string &listing)
{
    static const std::string wildcardCommand =
        kScp + kDriveVexaDirectory + "*/OSUpgrade.zip 192.168.9.2:/root/ && " + kScp
        + kDriveVexaDirectory + "*/unzipUpgrade.sh 192.168.9.2:/";
    if (TextLines::split(listing).size() == 1)
        return wildcardCommand;

    const std::string directory = kDriveVexaDirectory + TextLines::firstLine(listing) + "/";
    return kScp + shellQuoted(directory + "OSUpgrade.zip") + " 192.168.9.2:/root/ && " + kScp
           + shellQuoted(directory + "unzipUpgrade.sh") + " 192.168.9.2:/";
}

} // namespace

bool UpdateManager::checkVexaUpdate(std::string &installed, std::string &candidate, bool &checkOk)
{
    static const std::string command =
        "ssh  -o ServerAliveInterval=4 -o ServerAliveCountMax=10 -o ConnectTimeout=2 -o TCPKeepAlive=yes "
        "192.168.9.2 \" cat /root/App/AppExe/version.txt | grep 'Quillowmarsh'\"";
    checkOk = false;
    installed.clear();
    candidate.clear();

    std::string output;
    if (runProcess(command, output) != 0) {
        UPDATER_LOG("Failed to checkUpdate");
        return false;
    }
    // The last tagged line wins; a tag without its TAB is no version line.
    for (std::string line : TextLines::split(output)) {
        if (TextLines::eraseThrough(line, kVersionTag))
            installed = line;
        UPDATER_LOG(line);
    }
    // The module writes its version file with DOS line endings.
    installed = installed.substr(0, installed.find('\r'));

    if (listDriveVersions(output) != 0) {
        UPDATER_LOG("Failed to check candidate VEXA version");
        return false;
    }
    candidate = TextLines::firstLine(output);
    UPDATER_LOG("QV ", installed, "  ", candidate);

    if (installed.empty() || candidate.empty()) {
        UPDATER_LOG("Failed to checkUpdate");
        return false;
    }
    checkOk = true;
    // Containment, not equality: a directory named 1.2.7 holds the module
    // software that reports itself as 1.2.
    if (candidate.find(installed) != std::string::npos) {
        UPDATER_LOG("VEXA up to date");
        return false;
    }
    UPDATER_LOG("Update found: ", installed, " -> ", candidate);
    return true;
}

bool UpdateManager::uploadVexaFiles()
{
    std::string listing;
    if (listDriveVersions(listing) != 0 || TextLines::firstLine(listing).empty()) {
        UPDATER_LOG("Failed to find VEXA candidate directory");
        return false;
    }
    const std::string command = uploadCommandFor(listing);
    UPDATER_LOG(command);

    // The link to the module drops now and then; every attempt copies both
    // files again, at once.
    for (int attempt = 0; attempt < kUploadAttempts; ++attempt) {
        if (std::system(command.c_str()) == 0)
            return true;
        UPDATER_LOG("Uploading failed. Trying again. ", attempt);
    }
    UPDATER_LOG("Failed to upload VEXA with 20 tries. Closing");
    return false;
}

bool UpdateManager::installVexaUpdate()
{
    UPDATER_LOG();
    if (!uploadVexaFiles()) {
        UPDATER_LOG("Failed inside uploadVexaFiles");
        return false;
    }

    static const std::string command =
        "ssh  -o ServerAliveInterval=4 -o ServerAliveCountMax=10 -o ConnectTimeout=2 -o TCPKeepAlive=yes "
        "192.168.9.2 \"/unzipUpgrade.sh\"";
    UPDATER_LOG(command);
    // The script's status says little: the module reboots while it runs and
    // the connection may drop. The verification afterwards decides.
    UPDATER_LOG("Install script ended with code: ", std::system(command.c_str()));

    UPDATER_LOG("Starts sleeping for 13mins");
    FixedWait::waitFor(FixedWait::kModuleInstallWait);
    UPDATER_LOG("Sleeping for 13mins ended up");
    return verifyVexa();
}

bool UpdateManager::verifyVexa()
{
    std::string installed;
    std::string candidate;
    bool checkOk = false;
    // The module may still be rebooting: read it again a few seconds apart
    // before declaring the installation failed.
    for (int attempt = 0; attempt < kVerifyReads; ++attempt) {
        const bool stillDue = checkVexaUpdate(installed, candidate, checkOk);
        if (checkOk && !stillDue) {
            UPDATER_LOG("VEXA verified: ", installed);
            return true;
        }
        if (attempt + 1 == kVerifyReads)
            break;
        UPDATER_LOG("VEXA not verified yet. Trying again. ", attempt);
        FixedWait::waitFor(FixedWait::kModuleVerifyPause);
    }
    UPDATER_LOG("Failed to verify VEXA with 20 reads");
    return false;
}
