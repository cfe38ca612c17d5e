#include <QQmlContext>
#include <QQmlEngine>
#include <QtQuickTest>

#include "FakeInstrument.h"
#include "GuiUpdateManager.h"
#include "Translator.h"

// The bridge with its real signals, which a test emits itself; its invokables
// only report, through the *Called signals, what the scene asked of the engine.
class FakeUpdateManager : public GuiUpdateManager
{
    Q_OBJECT

public:
    using GuiUpdateManager::GuiUpdateManager;
    Q_INVOKABLE void init() { emit initCalled(); }
    Q_INVOKABLE void deinit() { emit deinitCalled(); }
    Q_INVOKABLE void update() { emit updateCalled(); }

signals:
    void initCalled();
    void deinitCalled();
    void updateCalled();
};

// Every test file gets a fresh updateManager and the application's translator and catalogues.
class Setup : public QObject
{
    Q_OBJECT

public slots:
    void applicationAvailable() { Translator::instance()->loadTranslations(QStringLiteral(":/languages")); }
    void qmlEngineAvailable(QQmlEngine *engine)
    {
        engine->rootContext()->setContextProperty(QStringLiteral("updateManager"), new FakeUpdateManager(engine));
        engine->rootContext()->setContextProperty(QStringLiteral("translator"), Translator::instance());
    }

private:
    // Should a call ever reach the real engine, it meets the fake instrument first on PATH.
    FakeInstrument mInstrument;
};

QUICK_TEST_MAIN_WITH_SETUP(qml, Setup)

#include "tst_qml.moc"
