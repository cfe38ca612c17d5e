#include "FixedWait.h"
#include "UpdateManager.h"
#include "UpdaterLog.h"

void UpdateManager::initRemoteHead()
{
    stopDRUV();
}

void UpdateManager::updateRemoteHead()
{
    static const std::string command = "apt-cache policy marlix4-rh";
    static const std::string updateCommand = "apt --assume-yes install marlix4-rh";
    UPDATER_LOG();

    std::string installed;
    std::string candidate;
    bool checkOk = false;

    if (!updateMirrors()) {
        UPDATER_LOG("Update mirrors failed:");
        instance()->mErrorCallback(UpdateMirrorsFailed);
        return;
    }

    checkOk = false;
    const bool updateAvailable = checkUpdate(true, command, installed, candidate, checkOk);
    if (!checkOk) {
        UPDATER_LOG("Failed to checkUpdate");
        instance()->mErrorCallback(CheckUpdateFailed);
        return;
    }
    if (updateAvailable && !installUpdate(updateCommand)) {
        UPDATER_LOG("update failed");
        instance()->mErrorCallback(UpdateFailed);
        return;
    }

    // From here on the three variables describe the module, not the package.
    const bool moduleDue = checkVexaUpdate(installed, candidate, checkOk);
    if (moduleDue) {
        if (!installVexaUpdate()) {
            UPDATER_LOG("update VEXA failed");
            instance()->mErrorCallback(UpdateVexaFailed);
            return;
        }
    } else if (!updateAvailable) {
        // Nothing was installed, so a module that could not be read changes
        // nothing on the instrument.
        instance()->mResultCallback(NoUpdates);
        return;
    }

    if (checkOk) {
        instance()->mResultCallback(UpdateFinished);
        return;
    }
    UPDATER_LOG("Failed to checkUpdate");
    instance()->mErrorCallback(CheckUpdateFailed);
}

void UpdateManager::deinitRemoteHead()
{
    UPDATER_LOG();
    FixedWait::waitFor(FixedWait::kServiceStartWait);
    startDRUV();
}
