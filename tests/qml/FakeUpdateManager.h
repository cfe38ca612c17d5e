#pragma once

#include <QObject>
#include <QString>

// Stands in for the bridge under its context-property name. A test emits the
// bridge's signals itself (signals are callable from QML) and watches the
// *Called signals to see what the scene asked of the engine.
class FakeUpdateManager : public QObject
{
    Q_OBJECT

public:
    using QObject::QObject;

    Q_INVOKABLE void init() { emit initCalled(); }
    Q_INVOKABLE void deinit() { emit deinitCalled(); }
    Q_INVOKABLE void update() { emit updateCalled(); }

signals:
    void error(int errorCode) const;
    void updateFound(QString updatesText) const;
    void noUpdate() const;
    void updateFinished() const;
    void checkUpdateFailed() const;
    void updateMirrorsFailed() const;
    void updateFailed() const;

    void initCalled() const;
    void deinitCalled() const;
    void updateCalled() const;
};
