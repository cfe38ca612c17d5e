#include "GuiUpdateManager.h"

#include <QDebug>

GuiUpdateManager::GuiUpdateManager(QObject *parent)
    : QObject(parent)
    , mUpdateManager(UpdateManager::instance())
{
}

GuiUpdateManager *GuiUpdateManager::instance()
{
    // Created by start-up on the GUI thread before the engine has any worker,
    // so the callbacks only ever read this pointer.
    static GuiUpdateManager *mInstance = nullptr;
    if (!mInstance)
        mInstance = new GuiUpdateManager(nullptr);
    return mInstance;
}

// The callbacks run on the engine's worker thread. They emit directly there;
// the scene's handlers live on the GUI thread, so Qt queues each emission.

void GuiUpdateManager::resultCallback(UpdateManager::Result result)
{
    switch (result) {
    case UpdateManager::NoUpdates:
        emit instance()->noUpdate();
        break;
    case UpdateManager::UpdateFinished:
        emit instance()->updateFinished();
        break;
    }
}

void GuiUpdateManager::errorCallback(UpdateManager::Error error)
{
    switch (error) {
    case UpdateManager::CheckUpdateFailed:
        emit instance()->checkUpdateFailed();
        return;
    case UpdateManager::UpdateMirrorsFailed:
        emit instance()->updateMirrorsFailed();
        return;
    case UpdateManager::UpdateFailed:
    case UpdateManager::UpdateVexaFailed:
        // The scene tells the user the same thing whichever part of the
        // instrument refused the update.
        emit instance()->updateFailed();
        return;
    }
    qDebug() << "Unhandled errorCode:" << static_cast<int>(error);
    emit instance()->error(error);
}

void GuiUpdateManager::updateFoundCallback(std::vector<UpdateManager::UpdateComponent> components)
{
    // The list stays here until the user confirms; the scene only asks the
    // question and never sees what is in it.
    instance()->mComponents = std::move(components);
    emit instance()->updateFound(QString());
}

void GuiUpdateManager::init()
{
    mUpdateManager->setCallbacks(resultCallback, errorCallback, updateFoundCallback);
    mUpdateManager->init(false);
}

void GuiUpdateManager::deinit()
{
    mUpdateManager->deinit(false);
}

void GuiUpdateManager::update()
{
    // The engine takes its own copy; ours stays, so a second update() sends
    // the same components again.
    mUpdateManager->update(mComponents, false);
}
