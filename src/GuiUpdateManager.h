#pragma once

#include <QObject>
#include <QString>

#include <vector>

#include "UpdateManager.h"

// The update engine as the scene sees it: the engine's callbacks become
// signals, and the scene drives the engine through three invokables. The bridge
// keeps the components of the last offer so that update() can hand exactly
// that list back to the engine.
class GuiUpdateManager : public QObject
{
    Q_OBJECT

public:
    explicit GuiUpdateManager(QObject *parent = nullptr);

    static GuiUpdateManager *instance();

    static void resultCallback(UpdateManager::Result result);
    static void errorCallback(UpdateManager::Error error);
    static void updateFoundCallback(std::vector<UpdateManager::UpdateComponent> components);

    Q_INVOKABLE void init();
    Q_INVOKABLE void deinit();
    Q_INVOKABLE void update();

signals:
    void error(int errorCode) const;
    void updateFound(QString updatesText) const;
    void noUpdate() const;
    void updateFinished() const;
    void checkUpdateFailed() const;
    void updateMirrorsFailed() const;
    void updateFailed() const;

private:
    UpdateManager *mUpdateManager;
    std::vector<UpdateManager::UpdateComponent> mComponents;
};
