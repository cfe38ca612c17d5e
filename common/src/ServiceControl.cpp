#include "FixedWait.h"
#include "UpdateManager.h"
#include "UpdaterLog.h"

#include <cstdlib>

// The status of each service command is only logged, as the raw value that
// system() returns: a missing service or a drive that is already unmounted
// must not keep the instrument from getting its service back.

void UpdateManager::stopDRUV()
{
    UPDATER_LOG();
    static const std::string command = "systemctl stop druv";
    UPDATER_LOG(std::system(command.c_str()));
}

void UpdateManager::startDRUV()
{
    UPDATER_LOG();
    // The drive goes first: once druv runs again, nothing may read the
    // update tree any more.
    static const std::string unmountCommand = "umount /root/USB_MOUNT/";
    static const std::string startCommand = "systemctl start druv";
    UPDATER_LOG(std::system(unmountCommand.c_str()));
    UPDATER_LOG(std::system(startCommand.c_str()));
    FixedWait::waitFor(FixedWait::kServiceStartWait);
    stopUpdater();
}

void UpdateManager::stopUpdater()
{
    UPDATER_LOG();
    // When the updater runs as the druv-updater service, this stop ends it.
    static const std::string command = "systemctl stop druv-updater";
    UPDATER_LOG(std::system(command.c_str()));
}
