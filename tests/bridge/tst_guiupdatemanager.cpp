#include <QThread>
#include <QtTest>

#include <algorithm>
#include <thread>

#include "FakeInstrument.h"
#include "GuiUpdateManager.h"

namespace {

// Every signal of the bridge as a receiver on the GUI thread sees it, marking any other thread.
struct EmissionLog : QObject
{
    QStringList arrived;
    void record(const QString &emission)
    {
        arrived << (QThread::currentThread() == qApp->thread() ? emission : "off the GUI thread: " + emission);
    }
    EmissionLog()
    {
        const auto *bridge = GuiUpdateManager::instance();
        connect(bridge, &GuiUpdateManager::error, this, [this](int code) { record(QString("error %1").arg(code)); });
        connect(bridge, &GuiUpdateManager::updateFound, this, [this](const QString &t) { record("updateFound \"" + t + '"'); });
        connect(bridge, &GuiUpdateManager::noUpdate, this, [this] { record("noUpdate"); });
        connect(bridge, &GuiUpdateManager::updateFinished, this, [this] { record("updateFinished"); });
        connect(bridge, &GuiUpdateManager::checkUpdateFailed, this, [this] { record("checkUpdateFailed"); });
        connect(bridge, &GuiUpdateManager::updateMirrorsFailed, this, [this] { record("updateMirrorsFailed"); });
        connect(bridge, &GuiUpdateManager::updateFailed, this, [this] { record("updateFailed"); });
    }
};
} // namespace

class GuiUpdateManagerTest : public QObject
{
    Q_OBJECT

private slots:
    void offersTheSceneExactlyItsSignalsAndInvokables()
    {
        const QMetaObject &meta = GuiUpdateManager::staticMetaObject;
        QStringList methods;
        for (int i = meta.methodOffset(); i < meta.methodCount(); ++i) {
            const QMetaMethod m = meta.method(i);
            QVERIFY(m.access() == QMetaMethod::Public);
            methods << QString("%1 %2 %3").arg(m.methodType()).arg(m.methodSignature(), m.parameterNames().join(','));
        }
        QCOMPARE(methods, (QStringList{"1 error(int) errorCode", "1 updateFound(QString) updatesText",
                                       "1 noUpdate() ", "1 updateFinished() ", "1 checkUpdateFailed() ",
                                       "1 updateMirrorsFailed() ", "1 updateFailed() ", "0 init() ",
                                       "0 deinit() ", "0 update() "}));
        QCOMPARE(meta.propertyCount(), meta.propertyOffset());
    }

    // Every known and unknown outcome from an engine worker reaches the GUI thread queued, in order.
    void deliversEachEngineOutcomeAsItsSignalQueuedToTheGuiThread()
    {
        EmissionLog log;
        QTest::ignoreMessage(QtDebugMsg, "Unhandled errorCode: 4");
        QTest::ignoreMessage(QtDebugMsg, "Unhandled errorCode: -1");
        std::thread([] {
            for (int result : {0, 1, 2})
                GuiUpdateManager::resultCallback(static_cast<UpdateManager::Result>(result));
            for (int error : {0, 1, 2, 3, 4, -1})
                GuiUpdateManager::errorCallback(static_cast<UpdateManager::Error>(error));
            GuiUpdateManager::updateFoundCallback({{UpdateManager::MainHead, "Marlix IV", "4.1.0", "4.2.0"},
                                                   {UpdateManager::VexaModule, "VEXA", "7.2", "7.3"}});
        }).join();
        QVERIFY(log.arrived.isEmpty());
        QTRY_COMPARE(log.arrived, (QStringList{"noUpdate", "updateFinished", "checkUpdateFailed",
                                               "updateMirrorsFailed", "updateFailed", "updateFailed", "error 4",
                                               "error -1", "updateFound \"\""}));
    }

    void updateSendsTheStoredOfferAndKeepsIt()
    {
        FakeInstrument instrument;
        instrument.answer("apt-cache policy marlix4-dh", "marlix4-dh:\n  Installed: 4.1.0\n  Candidate: 4.2.0\n");
        instrument.answer("ssh *version.txt*", "Quillowmarsh\t7.3\n");
        instrument.answer("ls /root/USB_MOUNT/debs/VEXA/armhf/", "7.3\n");
        EmissionLog log;
        GuiUpdateManager::instance()->init();
        QTRY_COMPARE_WITH_TIMEOUT(log.arrived, QStringList{"updateFound \"\""}, 10000);
        // Each update() sends the engine's offer of the head package again, until a
        // later offer replaces it whole: the installer skips a component it does not know.
        for (int round = 1; round <= 3; ++round) {
            if (round == 3)
                GuiUpdateManager::updateFoundCallback({{static_cast<UpdateManager::ComponentType>(7), "?", "", ""}});
            GuiUpdateManager::instance()->update();
            QTRY_COMPARE_WITH_TIMEOUT(log.arrived.count("updateFinished"), round, 10000);
            const auto journal = instrument.journal();
            QCOMPARE(int(std::count(journal.begin(), journal.end(), "apt --assume-yes install marlix4-dh")), std::min(round, 2));
        }
    }
};

QTEST_GUILESS_MAIN(GuiUpdateManagerTest)
#include "tst_guiupdatemanager.moc"
