#include "UpdateManager.h"
#include "UpdaterLog.h"

void UpdateManager::initMainHead()
{
    UPDATER_LOG();
    // The instrument application must not run while its software is checked
    // and replaced; it stays stopped until the wind-down.
    stopDRUV();

    static const std::string dhPackageCommand = "apt-cache policy marlix4-dh";
    std::string installed;
    std::string candidate;
    std::vector<UpdateComponent> components;
    bool checkOk = false;

    if (!updateMirrors()) {
        UPDATER_LOG("Update mirrors failed:");
        instance()->mErrorCallback(UpdateMirrorsFailed);
        return;
    }

    checkOk = false;
    if (checkUpdate(true, dhPackageCommand, installed, candidate, checkOk))
        components.push_back({MainHead, "Marlix IV", installed, candidate});
    if (!checkOk) {
        UPDATER_LOG("Failed to checkUpdate");
        instance()->mErrorCallback(CheckUpdateFailed);
        return;
    }

    if (checkVexaUpdate(installed, candidate, checkOk))
        components.push_back({VexaModule, "VEXA", installed, candidate});
    if (!checkOk) {
        UPDATER_LOG("Failed to checkUpdate");
        instance()->mErrorCallback(CheckUpdateFailed);
        return;
    }

    if (components.empty())
        instance()->mResultCallback(NoUpdates);
    else
        instance()->mUpdateFoundCallback(components);
}

void UpdateManager::updateMainHead(std::vector<UpdateComponent> components)
{
    UPDATER_LOG();
    static const std::string command = "apt --assume-yes install marlix4-dh";
    for (const UpdateComponent &component : components) {
        UPDATER_LOG("QV ", static_cast<int>(component.type), " == ", 0);
        if (component.type == MainHead && !installUpdate(command)) {
            instance()->mErrorCallback(UpdateFailed);
            return;
        }
        if (component.type == VexaModule && !installVexaUpdate()) {
            instance()->mErrorCallback(UpdateVexaFailed);
            return;
        }
    }
    instance()->mResultCallback(UpdateFinished);
}

void UpdateManager::deinitMainHead()
{
    startDRUV();
}

bool UpdateManager::installUpdate(const std::string &command)
{
    UPDATER_LOG();
    std::string output;
    const int exitCode = runProcess(command, output);
    if (exitCode == 0)
        return true;
    UPDATER_LOG(exitCode, output);
    return false;
}
