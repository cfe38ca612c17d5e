// A front end that forgot a callback must be stopped at the door in every
// build, release builds included: a worker would otherwise call a null
// pointer in the middle of an installation.
#undef NDEBUG
#include <cassert>

#include "UpdateManager.h"
#include "UpdaterLog.h"

template <typename Body, typename... Args>
void UpdateManager::startWorker(Body &&body, Args &&...args)
{
    // Destroying a joinable thread would end the whole process.
    if (mThread && mThread->joinable())
        mThread->detach();
    mThread = std::make_unique<std::thread>(std::forward<Body>(body), std::forward<Args>(args)...);
}

UpdateManager *UpdateManager::instance()
{
    static UpdateManager *mInstance = new UpdateManager();
    return mInstance;
}

void UpdateManager::setCallbacks(ResultCallback resultCallback, ErrorCallback errorCallback,
                                 UpdateFoundCallback updateFoundCallback)
{
    UPDATER_LOG();
    mResultCallback = resultCallback;
    mErrorCallback = errorCallback;
    mUpdateFoundCallback = updateFoundCallback;
}

bool UpdateManager::validateCallbacks()
{
    return mResultCallback && mErrorCallback && mUpdateFoundCallback;
}

void UpdateManager::init(bool isRemoteHead)
{
    UPDATER_LOG();
    assert(validateCallbacks());
    if (isRemoteHead) {
        initRemoteHead();
        return;
    }
    startWorker(&UpdateManager::initMainHead);
}

void UpdateManager::deinit(bool isRemoteHead)
{
    UPDATER_LOG();
    assert(validateCallbacks());
    if (isRemoteHead) {
        deinitRemoteHead();
        return;
    }
    startWorker(&UpdateManager::deinitMainHead);
}

void UpdateManager::update(std::vector<UpdateComponent> components, bool isRemoteHead)
{
    UPDATER_LOG();
    assert(validateCallbacks());
    if (isRemoteHead) {
        updateRemoteHead();
        return;
    }
    // The installation must not overlap the check that offered it.
    if (mThread && mThread->joinable())
        mThread->join();
    mThread.reset();
    startWorker(&UpdateManager::updateMainHead, std::move(components));
}
