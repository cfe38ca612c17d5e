#include "TextLines.h"
#include "UpdateManager.h"
#include "UpdaterLog.h"

bool UpdateManager::updateMirrors()
{
    UPDATER_LOG();
    static const std::string command = "apt update";
    std::string output;
    const int exitCode = runProcess(command, output);
    if (exitCode == 0) {
        UPDATER_LOG("OK");
        return true;
    }
    if (exitCode == 100) {
        UPDATER_LOG("NO_INTERNET_ERROR_CODE");
        return false;
    }
    UPDATER_LOG("NOT OK ", exitCode);
    return false;
}

bool UpdateManager::checkUpdate(bool skipNoInternetCheck, const std::string &command,
                                std::string &installed, std::string &candidate, bool &checkOk)
{
    UPDATER_LOG(command);
    checkOk = false;
    installed.clear();
    candidate.clear();

    std::string output;
    const int exitCode = runProcess(command, output);
    if (exitCode == 100 && !skipNoInternetCheck) {
        UPDATER_LOG("NO_INTERNET_ERROR_CODE");
        return false;
    }

    const std::string installedKey = "Installed: ";
    const std::string candidateKey = "Candidate: ";
    for (std::string line : TextLines::split(output)) {
        if (TextLines::eraseThrough(line, installedKey))
            installed = line;
        else if (TextLines::eraseThrough(line, candidateKey))
            candidate = line;
        UPDATER_LOG(line);
    }
    UPDATER_LOG(installed, "  ", candidate);

    if (installed.empty() || candidate.empty()) {
        UPDATER_LOG("NWM_UM_CHECK_UPDATE_FAILED");
        return false;
    }
    checkOk = true;
    // Versions are compared as text: any difference, an older candidate
    // included, is an update.
    if (installed == candidate) {
        UPDATER_LOG("NWM_UM_NO_UPDATES ", installed, " == ", candidate);
        return false;
    }
    UPDATER_LOG("NWM_UM_UPDATE_FOUND: ", installed, " -> ", candidate);
    return true;
}
