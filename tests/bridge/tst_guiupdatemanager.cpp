#include <QThread>
#include <QtTest>

#include <algorithm>
#include <thread>

#include "FakeInstrument.h"
#include "GuiUpdateManager.h"

namespace {

QStringList loggedMessages;

void logMessage(QtMsgType, const QMessageLogContext &, const QString &message)
{
    loggedMessages.append(message);
}

// Every signal of the bridge as a receiver on the creating thread sees it,
// with the thread that ran the receiver.
class EmissionLog : public QObject
{
public:
    EmissionLog()
    {
        const GuiUpdateManager *bridge = GuiUpdateManager::instance();
        connect(bridge, &GuiUpdateManager::error, this,
                [this](int errorCode) { record(QStringLiteral("error %1").arg(errorCode)); });
        connect(bridge, &GuiUpdateManager::updateFound, this,
                [this](const QString &text) { record("updateFound \"" + text + '"'); });
        connect(bridge, &GuiUpdateManager::noUpdate, this, [this] { record("noUpdate"); });
        connect(bridge, &GuiUpdateManager::updateFinished, this, [this] { record("updateFinished"); });
        connect(bridge, &GuiUpdateManager::checkUpdateFailed, this, [this] { record("checkUpdateFailed"); });
        connect(bridge, &GuiUpdateManager::updateMirrorsFailed, this, [this] { record("updateMirrorsFailed"); });
        connect(bridge, &GuiUpdateManager::updateFailed, this, [this] { record("updateFailed"); });
    }

    QStringList arrived;
    QList<QThread *> threads;

private:
    void record(const QString &emission)
    {
        arrived.append(emission);
        threads.append(QThread::currentThread());
    }
};

const std::vector<UpdateManager::UpdateComponent> headAndModule{
    {UpdateManager::MainHead, "Marlix IV", "4.1.0", "4.2.0"},
    {UpdateManager::VexaModule, "VEXA", "7.2", "7.3"},
};

long headInstalls(const FakeInstrument &instrument)
{
    const auto journal = instrument.journal();
    return std::count(journal.begin(), journal.end(), "apt --assume-yes install marlix4-dh");
}

} // namespace

class GuiUpdateManagerTest : public QObject
{
    Q_OBJECT

private slots:
    void offersTheSceneExactlyItsSignalsAndInvokables();
    void turnsEachEngineOutcomeIntoItsSignal_data();
    void turnsEachEngineOutcomeIntoItsSignal();
    void deliversWorkerEmissionsQueuedToTheGuiThreadInOrder();
    void updateSendsTheStoredOfferAndKeepsIt();
};

void GuiUpdateManagerTest::offersTheSceneExactlyItsSignalsAndInvokables()
{
    struct Method
    {
        QMetaMethod::MethodType kind;
        const char *signature;
        QByteArrayList parameterNames;
    };
    const Method expected[] = {
        {QMetaMethod::Signal, "error(int)", {"errorCode"}},
        {QMetaMethod::Signal, "updateFound(QString)", {"updatesText"}},
        {QMetaMethod::Signal, "noUpdate()", {}},
        {QMetaMethod::Signal, "updateFinished()", {}},
        {QMetaMethod::Signal, "checkUpdateFailed()", {}},
        {QMetaMethod::Signal, "updateMirrorsFailed()", {}},
        {QMetaMethod::Signal, "updateFailed()", {}},
        {QMetaMethod::Method, "init()", {}},
        {QMetaMethod::Method, "deinit()", {}},
        {QMetaMethod::Method, "update()", {}},
    };
    const QMetaObject &meta = GuiUpdateManager::staticMetaObject;
    QCOMPARE(meta.methodCount() - meta.methodOffset(), int(std::size(expected)));
    QCOMPARE(meta.propertyCount(), meta.propertyOffset());
    for (int index = 0; index < int(std::size(expected)); ++index) {
        const QMetaMethod method = meta.method(meta.methodOffset() + index);
        QCOMPARE(method.methodSignature(), QByteArray(expected[index].signature));
        QCOMPARE(method.methodType(), expected[index].kind);
        QCOMPARE(method.parameterNames(), expected[index].parameterNames);
        QCOMPARE(method.access(), QMetaMethod::Public);
    }
}

void GuiUpdateManagerTest::turnsEachEngineOutcomeIntoItsSignal_data()
{
    QTest::addColumn<QString>("callback");
    QTest::addColumn<int>("value");
    QTest::addColumn<QStringList>("emitted");
    QTest::addColumn<QStringList>("messages");

    QTest::newRow("no updates") << "result" << 0 << QStringList{"noUpdate"} << QStringList{};
    QTest::newRow("update finished") << "result" << 1 << QStringList{"updateFinished"} << QStringList{};
    QTest::newRow("unknown result") << "result" << 2 << QStringList{} << QStringList{};
    QTest::newRow("check failed") << "error" << 0 << QStringList{"checkUpdateFailed"} << QStringList{};
    QTest::newRow("mirrors failed") << "error" << 1 << QStringList{"updateMirrorsFailed"} << QStringList{};
    QTest::newRow("head failed") << "error" << 2 << QStringList{"updateFailed"} << QStringList{};
    QTest::newRow("module failed") << "error" << 3 << QStringList{"updateFailed"} << QStringList{};
    QTest::newRow("unknown error 4") << "error" << 4 << QStringList{"error 4"}
                                     << QStringList{"Unhandled errorCode: 4"};
    QTest::newRow("unknown error -1") << "error" << -1 << QStringList{"error -1"}
                                      << QStringList{"Unhandled errorCode: -1"};
    QTest::newRow("offer of two") << "offer" << 2 << QStringList{"updateFound \"\""} << QStringList{};
}

void GuiUpdateManagerTest::turnsEachEngineOutcomeIntoItsSignal()
{
    QFETCH(QString, callback);
    QFETCH(int, value);
    QFETCH(QStringList, emitted);
    QFETCH(QStringList, messages);

    EmissionLog log;
    loggedMessages.clear();
    const QtMessageHandler previousHandler = qInstallMessageHandler(logMessage);
    if (callback == "result")
        GuiUpdateManager::resultCallback(static_cast<UpdateManager::Result>(value));
    else if (callback == "error")
        GuiUpdateManager::errorCallback(static_cast<UpdateManager::Error>(value));
    else
        GuiUpdateManager::updateFoundCallback(headAndModule);
    qInstallMessageHandler(previousHandler);

    QCOMPARE(log.arrived, emitted);
    QCOMPARE(loggedMessages, messages);
}

void GuiUpdateManagerTest::deliversWorkerEmissionsQueuedToTheGuiThreadInOrder()
{
    EmissionLog log;
    std::thread worker([] {
        GuiUpdateManager::updateFoundCallback(headAndModule);
        GuiUpdateManager::errorCallback(UpdateManager::UpdateVexaFailed);
        GuiUpdateManager::resultCallback(UpdateManager::UpdateFinished);
        GuiUpdateManager::errorCallback(UpdateManager::UpdateMirrorsFailed);
    });
    worker.join();

    // The receiver sees nothing until the GUI thread's event loop runs.
    QVERIFY(log.arrived.isEmpty());
    QTRY_COMPARE(log.arrived,
                 (QStringList{"updateFound \"\"", "updateFailed", "updateFinished", "updateMirrorsFailed"}));
    for (QThread *thread : log.threads)
        QCOMPARE(thread, QThread::currentThread());
}

void GuiUpdateManagerTest::updateSendsTheStoredOfferAndKeepsIt()
{
    FakeInstrument instrument;
    instrument.answer("apt-cache policy marlix4-dh", "marlix4-dh:\n  Installed: 4.1.0\n  Candidate: 4.2.0\n");
    instrument.answer("ssh *version.txt*", "Quillowmarsh\t7.3\n");
    instrument.answer("ls /root/USB_MOUNT/debs/VEXA/armhf/", "7.3\n");
    GuiUpdateManager *bridge = GuiUpdateManager::instance();
    EmissionLog log;
    const auto finished = [&log] { return log.arrived.count("updateFinished"); };

    bridge->init();
    QTRY_COMPARE_WITH_TIMEOUT(log.arrived, QStringList{"updateFound \"\""}, 10000);
    QCOMPARE(headInstalls(instrument), 0);

    // The engine's offer of the head package goes back to it, and stays.
    for (int round = 1; round <= 2; ++round) {
        bridge->update();
        QTRY_COMPARE_WITH_TIMEOUT(finished(), round, 10000);
        QCOMPARE(headInstalls(instrument), round);
    }

    // A later offer replaces the stored one whole; the installer skips a
    // component it does not know, so nothing more is installed.
    GuiUpdateManager::updateFoundCallback({{static_cast<UpdateManager::ComponentType>(7), "?", "", ""}});
    bridge->update();
    QTRY_COMPARE_WITH_TIMEOUT(finished(), 3, 10000);
    QCOMPARE(headInstalls(instrument), 2);
}

QTEST_GUILESS_MAIN(GuiUpdateManagerTest)
#include "tst_guiupdatemanager.moc"
